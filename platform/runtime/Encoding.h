#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <string_view>
#include <type_traits>

#include "platform/runtime/Name.h"
#include "platform/runtime/Object.h"

namespace tavro {

/// Text that the compiler puts together.
template <std::size_t N>
struct FixedText {
  std::array<char, N + 1> characters{};

  constexpr FixedText() = default;
  // NOLINTNEXTLINE(google-explicit-constructor): a literal is such a text.
  constexpr FixedText(const char (&literal)[N + 1]) {
    for (std::size_t i = 0; i < N; ++i) {
      characters[i] = literal[i];
    }
  }
  [[nodiscard]] constexpr std::string_view view() const { return {characters.data(), N}; }

  template <std::size_t M>
  friend constexpr FixedText<N + M> operator+(const FixedText& left, const FixedText<M>& right) {
    FixedText<N + M> both;
    for (std::size_t i = 0; i < N; ++i) {
      both.characters[i] = left.characters[i];
    }
    for (std::size_t i = 0; i < M; ++i) {
      both.characters[N + i] = right.characters[i];
    }
    return both;
  }
};
template <std::size_t N>
FixedText(const char (&)[N]) -> FixedText<N - 1>;

template <class T>
inline constexpr bool kIsReference = std::is_base_of_v<id, T>;

template <class T>
inline constexpr bool kIsObjectPointer =
    std::is_pointer_v<T>&& std::is_base_of_v<Object, std::remove_pointer_t<T>>;

/// The type that crosses a message for a C++ type: all objects travel as one type, and integers as
/// 64 bits, so that `send(view, "setTag:", 3)` means what it says.
template <class T>
struct Travel {
  using Argument = T;
  using Result = T;
};
template <class T>
requires(kIsReference<T>) struct Travel<T> {
  using Argument = Object*;
  using Result = id;
};
template <class T>
requires(kIsObjectPointer<T> && !std::is_same_v<T, Class*>) struct Travel<T> {
  using Argument = Object*;
  using Result = id;
};
template <>
struct Travel<std::nullptr_t> {
  using Argument = Object*;
};
template <class T>
requires((std::is_integral_v<T> || std::is_enum_v<T>)&&!std::is_same_v<T, bool>) struct Travel<T> {
  static constexpr bool isSigned =
      std::is_signed_v<typename std::conditional_t<std::is_enum_v<T>, std::underlying_type<T>,
                                                   std::type_identity<T>>::type>;
  using Argument = std::conditional_t<isSigned, std::int64_t, std::uint64_t>;
  using Result = std::conditional_t<sizeof(T) == 8, Argument, T>;
};
template <class R, class... A>
struct Travel<std::function<R(A...)>> {
  using Argument = const std::function<R(A...)>&;
};

/// The type-encoding text of a type that has crossed `Travel`. A block carries its own signature
/// between angle brackets, so that a block of another type is a wrong signature too.
template <class T>
struct Encoding;
template <>
struct Encoding<void> {
  static constexpr FixedText text{"v"};
};
template <>
struct Encoding<bool> {
  static constexpr FixedText text{"B"};
};
template <>
struct Encoding<std::int64_t> {
  static constexpr FixedText text{"q"};
};
template <>
struct Encoding<std::uint64_t> {
  static constexpr FixedText text{"Q"};
};
template <>
struct Encoding<std::int32_t> {
  static constexpr FixedText text{"i"};
};
template <>
struct Encoding<float> {
  static constexpr FixedText text{"f"};
};
template <>
struct Encoding<double> {
  static constexpr FixedText text{"d"};
};
template <>
struct Encoding<id> {
  static constexpr FixedText text{"@"};
};
template <>
struct Encoding<Object*> {
  static constexpr FixedText text{"@"};
};
template <>
struct Encoding<id*> {
  static constexpr FixedText text{"^@"};
};
template <>
struct Encoding<Class*> {
  static constexpr FixedText text{"#"};
};
template <>
struct Encoding<Name> {
  static constexpr FixedText text{":"};
};

template <class T>
using TravelArgument = typename Travel<std::decay_t<T>>::Argument;
template <class T>
using TravelResult = typename Travel<std::decay_t<T>>::Result;

/// Result first, then each argument, separated by commas: "v,@,q".
template <class R, class... A>
struct SignatureText {
  static constexpr auto text =
      (Encoding<R>::text + ... + (FixedText{","} + Encoding<std::remove_cvref_t<A>>::text));
};

template <class R, class... A>
struct Encoding<std::function<R(A...)>> {
  static constexpr auto text = FixedText{"@?<"} +
                               SignatureText<TravelResult<R>, TravelArgument<A>...>::text +
                               FixedText{">"};
};

/// What a method takes and yields, compared as one integer. The receiver and the selector are not
/// part of it.
struct Signature {
  std::uint64_t hash = 0;
  std::string_view encodings;

  friend constexpr bool operator==(Signature left, Signature right) {
    return left.hash == right.hash;
  }
};

template <class R, class... A>
inline constexpr Signature kSignature{Name::hashOf(SignatureText<R, A...>::text.view()),
                                      SignatureText<R, A...>::text.view()};

}  // namespace tavro
