#pragma once

#include <array>
#include <memory_resource>
#include <string>
#include <string_view>

namespace tavro {

/// A text that grows while it is put together, and is copied when it is whole: within a usual
/// length it takes no memory but its own.
class TextBuffer {
 public:
  TextBuffer() { text_.reserve(kUsualLength); }
  TextBuffer(const TextBuffer&) = delete;
  TextBuffer& operator=(const TextBuffer&) = delete;

  TextBuffer& operator+=(std::u16string_view part) {
    text_ += part;
    return *this;
  }
  [[nodiscard]] std::u16string_view text() const { return text_; }

 private:
  static constexpr std::size_t kUsualLength = 127;

  std::array<std::byte, (kUsualLength + 1) * sizeof(char16_t)> memory_;
  std::pmr::monotonic_buffer_resource resource_{memory_.data(), memory_.size()};
  std::pmr::u16string text_{&resource_};
};

}  // namespace tavro
