#include "cimhost/LibraryCheck.h"

#include <elf.h>
#include <sys/stat.h>

#include <cerrno>
#include <cstring>
#include <fstream>

namespace cimhost {

namespace {

constexpr unsigned char kOwnClass = sizeof(void*) == 8 ? ELFCLASS64 : ELFCLASS32;

std::string wordSize(unsigned char elfClass) {
  return elfClass == ELFCLASS64 ? "64-bit" : "32-bit";
}

std::string shownName(const std::string& library) {
  const std::string above = "../";
  return library.compare(0, above.size(), above) == 0 ? library.substr(above.size()) : library;
}

std::string problemOf(const std::string& library) {
  struct stat status {};
  if (stat(library.c_str(), &status) != 0) return ": " + std::string(std::strerror(errno));
  // A pipe is not opened: nobody may be at its other end.
  if (!S_ISREG(status.st_mode)) return ": not a regular file";
  std::ifstream file(library, std::ios::binary);
  if (!file) return ": " + std::string(std::strerror(errno));
  char start[EI_NIDENT] = {};
  file.read(start, sizeof start);
  if (std::memcmp(start, ELFMAG, SELFMAG) != 0) return " is not a shared library";
  const auto elfClass = static_cast<unsigned char>(start[EI_CLASS]);
  if (elfClass == kOwnClass) return {};
  return " is a " + wordSize(elfClass) + " library, cimhost a " + wordSize(kOwnClass) + " program";
}

}  // namespace

std::string libraryProblem(const std::string& library) {
  if (library.find('/') == std::string::npos) return {};
  const std::string problem = problemOf(library);
  return problem.empty() ? problem : shownName(library) + problem;
}

}  // namespace cimhost
