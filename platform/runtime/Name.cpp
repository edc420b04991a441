#include "platform/runtime/Name.h"

#include <mutex>
#include <string>
#include <unordered_map>

#include "platform/runtime/Exception.h"

namespace tavro {
namespace {

struct Texts {
  std::mutex mutex;
  std::unordered_map<std::uint64_t, std::string> byHash;
};

Texts& texts() {
  static auto* const instance = new Texts;  // outlives every static object that uses it
  return *instance;
}

}  // namespace

NameTable& NameTable::shared() {
  static NameTable table;
  return table;
}

const char* NameTable::add(std::uint64_t hash, std::string_view text) {
  Texts& known = texts();
  const std::lock_guard lock(known.mutex);
  const auto [entry, inserted] = known.byHash.try_emplace(hash, text);
  return inserted || entry->second == text ? entry->second.c_str() : nullptr;
}

Name Name::make(std::string_view text) {
  const std::uint64_t hash = hashOf(text);
  const char* kept = NameTable::shared().add(hash, text);
  if (kept == nullptr) {
    raise(kInternalInconsistencyException,
          "the name \"" + std::string(text) + "\" has the hash of another name");
  }
  return {hash, kept};
}

}  // namespace tavro
