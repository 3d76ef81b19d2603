// The files of a fuzzer's corpus, whole, cut at every 16th byte, and with single bytes changed.

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <iterator>
#include <string>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

namespace {

void run(const std::string& text) {
  LLVMFuzzerTestOneInput(reinterpret_cast<const std::uint8_t*>(text.data()), text.size());
}

std::vector<std::filesystem::path> corpus() {
  std::vector<std::filesystem::path> files;
  for (const auto& entry : std::filesystem::directory_iterator(CORPUS)) {
    files.push_back(entry.path());
  }
  std::sort(files.begin(), files.end());
  return files;
}

std::string contentOf(const std::filesystem::path& file) {
  std::ifstream stream(file, std::ios::binary);
  return {std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>()};
}

// The fuzzer ends the process when something is wrong; the last line then names the file.
TEST(Corpus, DoesNotBreakTheReader) {
  const std::vector<std::filesystem::path> files = corpus();
  ASSERT_GE(files.size(), 10u);
  for (const auto& file : files) {
    std::cout << file.filename() << std::endl;
    const std::string text = contentOf(file);
    ASSERT_FALSE(text.empty()) << file;
    run(text);
    for (std::size_t cut = 0; cut < text.size(); cut += 16) run(text.substr(0, cut));
    for (std::size_t at = 7; at < text.size(); at += 61) {
      std::string changed = text;
      changed[at] = static_cast<char>(changed[at] ^ (1 << (at % 8)));
      run(changed);
    }
  }
}

}  // namespace
