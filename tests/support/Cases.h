#pragma once

#include <gtest/gtest.h>

#include <array>
#include <functional>
#include <string>
#include <vector>

#include "platform/foundation/NSBundle.h"
#include "tests/support/Files.h"

namespace tavro {

/// The cases of a file in tests/data: `Columns` lines each, blank lines and "#" lines between them.
template <std::size_t Columns>
std::vector<std::array<std::string, Columns>> casesOf(const std::string& name) {
  std::ifstream file(TAVRO_SOURCE "/tests/data/" + name);
  std::vector<std::array<std::string, Columns>> cases;
  std::size_t column = 0;
  for (std::string line; std::getline(file, line);) {
    if (column == 0 && (line.empty() || line.starts_with('#'))) {
      continue;
    }
    if (column == 0) {
      cases.emplace_back();
    }
    cases.back()[column] = line;
    column = (column + 1) % Columns;
  }
  EXPECT_FALSE(cases.empty()) << name;
  EXPECT_EQ(column, 0U) << name << " ends inside a case";
  return cases;
}

/// What reading a file with this text complains of, without the file's name and the colon after it;
/// empty when it is content.
inline std::string complaintAbout(const std::string& text,
                                  const std::function<void(const std::string& path)>& read) {
  const TemporaryFolder folder;
  const std::string path = folder.file("read", text);
  try {
    read(path);
  } catch (const FileError& error) {
    const std::string complaint = error.what();
    EXPECT_TRUE(complaint.starts_with(path + ":")) << complaint;
    EXPECT_EQ(complaint.find('\n'), std::string::npos) << complaint;
    return complaint.substr(
        std::min(complaint.size(), complaint.find_first_not_of(' ', path.size() + 1)));
  }
  return "";
}

}  // namespace tavro
