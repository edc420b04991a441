#pragma once

#include <algorithm>

#include "platform/runtime/Encoding.h"

namespace tavro {

/// Lengths are in points; y grows downwards.
struct CGPoint {
  double x = 0;
  double y = 0;
  friend bool operator==(const CGPoint&, const CGPoint&) = default;
};

struct CGSize {
  double width = 0;
  double height = 0;
  friend bool operator==(const CGSize&, const CGSize&) = default;
};

struct CGRect {
  CGPoint origin;
  CGSize size;

  constexpr CGRect() = default;
  constexpr CGRect(double x, double y, double width, double height)
      : origin{x, y}, size{width, height} {}
  friend bool operator==(const CGRect&, const CGRect&) = default;

  [[nodiscard]] double maxX() const { return origin.x + size.width; }
  [[nodiscard]] double maxY() const { return origin.y + size.height; }
  [[nodiscard]] CGPoint center() const {
    return {origin.x + size.width / 2, origin.y + size.height / 2};
  }
  /// The left and upper edges belong to the rectangle, the right and lower ones do not.
  [[nodiscard]] bool contains(CGPoint point) const {
    return point.x >= origin.x && point.x < maxX() && point.y >= origin.y && point.y < maxY();
  }
};

inline constexpr CGRect CGRectZero;

/// The smallest rectangle that holds both. The zero rectangle counts like any other.
inline CGRect CGRectUnion(const CGRect& left, const CGRect& right) {
  const double x = std::min(left.origin.x, right.origin.x);
  const double y = std::min(left.origin.y, right.origin.y);
  return {x, y, std::max(left.maxX(), right.maxX()) - x, std::max(left.maxY(), right.maxY()) - y};
}

template <>
struct Encoding<CGPoint> {
  static constexpr FixedText text{"{CGPoint=dd}"};
};
template <>
struct Encoding<CGSize> {
  static constexpr FixedText text{"{CGSize=dd}"};
};
template <>
struct Encoding<CGRect> {
  static constexpr FixedText text{"{CGRect={CGPoint=dd}{CGSize=dd}}"};
};

}  // namespace tavro
