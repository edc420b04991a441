#pragma once

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <nlohmann/json.hpp>
#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "platform/foundation/NSBundle.h"

namespace tavro {

// Reads a JSON file into plain structures by tables of their members. `fill` reads one value; each
// structure adds an overload of its own. Every fault is a `FileError` that names file, place and
// reason. Included by the one file that does the reading.

using Json = nlohmann::json;

/// A value of the file that knows where it stands.
class Place {
 public:
  Place(const Json& value, const std::string& file) : value_(value), file_(file) {}

  [[noreturn]] void fail(const std::string& reason) const {
    throw FileError(file_ + ": " + (path_.empty() ? "top level" : path_) + ": " + reason);
  }
  [[nodiscard]] const Json& value() const { return value_; }
  [[nodiscard]] Place operator[](std::string_view key) const {
    return {value_.at(std::string(key)), file_,
            path_.empty() ? std::string(key) : path_ + "." + std::string(key)};
  }
  [[nodiscard]] Place operator[](std::size_t index) const {
    return {value_.at(index), file_, path_ + "[" + std::to_string(index) + "]"};
  }
  /// Fails unless the value is what the reader expects here.
  void expect(bool isExpected, const std::string& what) const {
    if (!isExpected) {
      fail("expected " + what + ", found " + value_.type_name());
    }
  }

 private:
  Place(const Json& value, const std::string& file, std::string path)
      : value_(value), file_(file), path_(std::move(path)) {}

  const Json& value_;
  const std::string& file_;
  std::string path_;
};

inline void fill(const Place& place, std::string& text) {
  place.expect(place.value().is_string(), "a text");
  text = place.value().get<std::string>();
}

inline void fill(const Place& place, bool& flag) {
  place.expect(place.value().is_boolean(), "true or false");
  flag = place.value().get<bool>();
}

/// A number that may be negative.
inline double coordinate(const Place& place) {
  place.expect(place.value().is_number(), "a number");
  const auto number = place.value().get<double>();
  if (!std::isfinite(number)) {
    place.fail("the number is not finite");
  }
  return number;
}

inline void fill(const Place& place, double& amount) {
  amount = coordinate(place);
  if (amount < 0) {
    place.fail("the amount is negative");
  }
}

inline void fill(const Place& place, std::int64_t& count) {
  place.expect(place.value().is_number_unsigned(), "a whole number from 0");
  count = place.value().get<std::int64_t>();
  if (count < 0) {
    place.fail("the number is too large");
  }
}

/// The value that a text stands for.
template <class E>
struct Choice {
  std::string_view text;
  E value;
};

template <class E, std::size_t N>
void choose(const Place& place, E& chosen, const Choice<E> (&choices)[N]) {
  std::string text;
  fill(place, text);
  std::string known;
  for (const Choice<E>& choice : choices) {
    if (choice.text == text) {
      chosen = choice.value;
      return;
    }
    known += (known.empty() ? "" : ", ") + std::string(choice.text);
  }
  place.fail("\"" + text + "\" is none of: " + known);
}

inline void expectCount(const Place& place, std::size_t count) {
  place.expect(place.value().is_array(), "a list");
  if (place.value().size() != count) {
    place.fail("expected " + std::to_string(count) + " values, found " +
               std::to_string(place.value().size()));
  }
}

/// A value that may be null.
template <class T>
void fill(const Place& place, std::optional<T>& value) {
  if (!place.value().is_null()) {
    fill(place, value.emplace());
  }
}

template <class T, std::size_t N>
void fill(const Place& place, std::array<T, N>& values) {
  expectCount(place, N);
  for (std::size_t i = 0; i < N; ++i) {
    fill(place[i], values[i]);
  }
}

template <class T>
void fill(const Place& place, std::vector<T>& values) {
  place.expect(place.value().is_array(), "a list");
  for (std::size_t i = 0; i < place.value().size(); ++i) {
    fill(place[i], values.emplace_back());
  }
}

/// One member of an object and where it goes.
template <class T>
struct Member {
  std::string_view name;
  bool isRequired;
  void (*fill)(const Place&, T&);
};

/// A row of any table whose objects have that member, inherited ones included.
template <auto Pointer>
struct Row {
  std::string_view name;
  bool isRequired;

  template <class T>
  // NOLINTNEXTLINE(google-explicit-constructor): a row is a member of each such object.
  constexpr operator Member<T>() const {
    return {name, isRequired, [](const Place& place, T& object) { fill(place, object.*Pointer); }};
  }
};
template <auto Pointer>
constexpr Row<Pointer> required(std::string_view name) {
  return {name, true};
}
template <auto Pointer>
constexpr Row<Pointer> optional(std::string_view name) {
  return {name, false};
}

template <class T, std::size_t N>
void fillMembers(const Place& place, T& object, const Member<T> (&members)[N]) {
  place.expect(place.value().is_object(), "an object");
  for (const auto& [key, value] : place.value().items()) {
    const auto isNamed = [&key = key](const Member<T>& member) { return member.name == key; };
    if (std::none_of(std::begin(members), std::end(members), isNamed)) {
      place.fail("unknown member \"" + key + "\"");
    }
  }
  for (const Member<T>& member : members) {
    if (place.value().contains(member.name)) {
      member.fill(place[member.name], object);
    } else if (member.isRequired) {
      place.fail("the member \"" + std::string(member.name) + "\" is missing");
    }
  }
}

/// A number as the file would write it.
inline std::string numberText(double value) { return Json(value).dump(); }

/// Fails at the first entry of the list `name` that does not lie after the one before it.
template <class T, class Key, class Owner>
void expectAscending(const Place& place, std::string_view name, const std::vector<T>& entries,
                     Key Owner::*key) {
  for (std::size_t i = 1; i < entries.size(); ++i) {
    if (!(entries[i - 1].*key < entries[i].*key)) {
      place[name][i].fail("the entry does not lie after the one before it");
    }
  }
}

template <class T, class Key>
void expectUnique(const Place& place, std::string_view name, const std::vector<T>& entries,
                  Key T::*key, std::string_view keyName) {
  std::set<Key> seen;
  for (std::size_t i = 0; i < entries.size(); ++i) {
    if (!seen.insert(entries[i].*key).second) {
      place[name][i][keyName].fail("the " + std::string(keyName) + " stands there twice");
    }
  }
}

/// Refuses a member that stands twice in one object; the parser would keep the last in silence.
class DuplicateMembers {
 public:
  explicit DuplicateMembers(const std::string& file) : file_(file) {}

  bool operator()(int /*depth*/, Json::parse_event_t event, Json& parsed) {
    if (event == Json::parse_event_t::object_start) {
      open_.emplace_back();
    } else if (event == Json::parse_event_t::object_end) {
      open_.pop_back();
    } else if (event == Json::parse_event_t::key) {
      const auto key = parsed.get<std::string>();
      if (!open_.back().insert(key).second) {
        throw FileError(file_ + ": the member \"" + key + "\" stands twice in one object");
      }
    }
    return true;
  }

 private:
  const std::string& file_;
  std::vector<std::set<std::string>> open_;
};

/// "line 3, column 5: ..." of the parser's own message, which begins with its own name.
inline std::string withoutPrefix(std::string_view message) {
  for (const std::string_view prefix : {"] ", "parse error at ", "parse error: "}) {
    const std::size_t found = message.find(prefix);
    if (found != std::string_view::npos) {
      message.remove_prefix(found + prefix.size());
    }
  }
  return std::string(message);
}

/// The whole file.
inline Json readJson(const std::string& path) {
  if (!std::filesystem::exists(path)) {
    throw FileError(path + ": there is no such file");
  }
  std::ifstream stream(path, std::ios::binary);
  if (!stream || stream.peek() == std::ifstream::traits_type::eof()) {
    throw FileError(path + ": this is not a readable file, or it is empty");
  }
  try {
    return Json::parse(stream, DuplicateMembers(path));
  } catch (const Json::exception& error) {
    throw FileError(path + ": " + withoutPrefix(error.what()));
  }
}

}  // namespace tavro
