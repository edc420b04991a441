#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace tavro {

/// A selector, key, class or protocol name. Its 64-bit hash is its identity: comparing two names
/// compares two integers. A literal is hashed by the compiler, so a call site writes plain text.
/// Registration refuses two texts with one hash (see `NameTable`).
class Name {
 public:
  constexpr Name() = default;

  template <std::size_t N>
  // NOLINTNEXTLINE(google-explicit-constructor): call sites write the plain literal.
  consteval Name(const char (&literal)[N]) : hash_(hashOf({literal, N - 1})), text_(literal) {}

  /// The name with a text that is only known at run time. The text is copied once and kept for the
  /// life of the process. Raises when another registered text has the same hash.
  static Name make(std::string_view text);

  [[nodiscard]] constexpr std::uint64_t hash() const { return hash_; }
  [[nodiscard]] constexpr std::string_view text() const { return text_; }
  [[nodiscard]] constexpr bool empty() const { return *text_ == '\0'; }

  friend constexpr bool operator==(Name left, Name right) { return left.hash_ == right.hash_; }

  /// FNV-1a with a final mix, so that the low bits serve as a table index. Never 0.
  static constexpr std::uint64_t hashOf(std::string_view text) {
    std::uint64_t hash = 0xcbf29ce484222325U;
    for (const char c : text) {
      hash = (hash ^ static_cast<unsigned char>(c)) * 0x100000001b3U;
    }
    hash = (hash ^ (hash >> 32U)) * 0x9e3779b97f4a7c15U;
    hash ^= hash >> 29U;
    return hash == 0 ? 1 : hash;
  }

 private:
  constexpr Name(std::uint64_t hash, const char* text) : hash_(hash), text_(text) {}

  std::uint64_t hash_ = hashOf({});
  const char* text_ = "";
};

/// The texts behind the hashes in use. Process-wide, callable from any thread.
class NameTable {
 public:
  static NameTable& shared();

  /// Records that `hash` stands for `text` and returns the kept copy of the text, or nullptr when
  /// the hash already stands for another text.
  const char* add(std::uint64_t hash, std::string_view text);

 private:
  NameTable() = default;
};

}  // namespace tavro
