#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <fstream>
#include <iostream>
#include <string>
#include <string_view>

#include "platform/foundation/NSBundle.h"

// What the fuzzers share. A fuzzer is one source with this entry, which takes any input and ends
// the process where a promise is broken. `./dev fuzz` searches for such inputs; the ordinary tests
// replay the ones that are kept.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

namespace tavro::fuzz {

/// Ends the process unless the promise is kept.
inline void require(bool isKept, std::string_view promise, std::string_view detail = {}) {
  if (!isKept) {
    std::cerr << "broken promise: " << promise << "\n" << detail << "\n";
    std::abort();
  }
}

inline std::string_view textOf(const std::uint8_t* data, std::size_t size) {
  return {reinterpret_cast<const char*>(data), size};
}

/// Reads an input as numbers; when it is used up, as zeros.
class Bytes {
 public:
  explicit Bytes(std::string_view input) : rest_(input) {}

  [[nodiscard]] bool empty() const { return rest_.empty(); }
  std::size_t next() {
    if (rest_.empty()) {
      return 0;
    }
    const auto byte = static_cast<unsigned char>(rest_.front());
    rest_.remove_prefix(1);
    return byte;
  }
  /// A number below `count`, which is not 0.
  std::size_t below(std::size_t count) { return next() % count; }

 private:
  std::string_view rest_;
};

inline void write(const std::string& path, std::string_view content) {
  std::ofstream(path, std::ios::binary) << content;
}

/// What is wrong with a file is one line of valid UTF-8 that names it.
inline void requireOneSentence(std::string_view sentence, std::string_view path) {
  const bool isPlain = sentence.find_first_of("\n\r\t") == std::string_view::npos &&
                       sentence.find('\0') == std::string_view::npos;
  require(isPlain && string(sentence)->utf8() == sentence, "an error is one line", sentence);
  require(sentence.starts_with(path) && sentence.size() > path.size() + 2,
          "an error names the file and a reason", sentence);
}

}  // namespace tavro::fuzz
