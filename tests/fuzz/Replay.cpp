#include <algorithm>
#include <filesystem>
#include <vector>

#include "tests/fuzz/Fuzz.h"
#include "tests/support/Process.h"

/// Gives a fuzzer every file of the folders that are named, in the order of their names.
int main(int count, char** arguments) {
  std::vector<std::filesystem::path> files;
  for (int index = 1; index < count; ++index) {
    for (const auto& entry : std::filesystem::directory_iterator(arguments[index])) {
      files.push_back(entry.path());
    }
  }
  std::ranges::sort(files);
  for (const std::filesystem::path& file : files) {
    std::cerr << file.string() << "\n";  // the last one named is the one that fails
    const std::string input = tavro::contentOf(file);
    LLVMFuzzerTestOneInput(reinterpret_cast<const std::uint8_t*>(input.data()), input.size());
  }
  std::cout << files.size() << " inputs\n";
  return files.empty() ? 1 : 0;
}
