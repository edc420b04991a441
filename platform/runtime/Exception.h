#pragma once

#include <exception>
#include <string>
#include <string_view>

namespace tavro {

inline constexpr std::string_view kInvalidArgumentException = "NSInvalidArgumentException";
inline constexpr std::string_view kRangeException = "NSRangeException";
inline constexpr std::string_view kInternalInconsistencyException =
    "NSInternalInconsistencyException";

/// What the platform raises: a name that tells the kind of misuse and a reason for people.
class NSException : public std::exception {
 public:
  NSException(std::string_view name, std::string_view reason);
  ~NSException() override;

  [[nodiscard]] const std::string& name() const { return name_; }
  [[nodiscard]] const std::string& reason() const { return reason_; }
  [[nodiscard]] const char* what() const noexcept override { return text_.c_str(); }

 private:
  std::string name_;
  std::string reason_;
  std::string text_;
};

/// Throws an `NSException`.
[[noreturn]] void raise(std::string_view name, std::string_view reason);

}  // namespace tavro
