#include "fuzz/FuzzCheck.h"

#include <expat.h>

#include <cstdio>
#include <cstdlib>
#include <memory>

void check(bool good, const char* problem) {
  if (good) return;
  std::fprintf(stderr, "%s\n", problem);
  std::abort();
}

void checkWellFormed(std::string_view text) {
  const std::unique_ptr<XML_ParserStruct, decltype(&XML_ParserFree)> parser(
      XML_ParserCreate("UTF-8"), &XML_ParserFree);
  const int size = static_cast<int>(text.size());
  const bool good = XML_Parse(parser.get(), text.data(), size, XML_TRUE) == XML_STATUS_OK;
  if (!good) std::fwrite(text.data(), 1, text.size(), stderr);
  check(good, "not well-formed");
}
