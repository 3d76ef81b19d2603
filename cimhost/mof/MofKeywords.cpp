#include "cimhost/mof/MofKeywords.h"

#include "cimhost/repository/QualifierScope.h"

namespace cimhost {
namespace {

template <class Meaning>
struct Keyword {
  std::string_view name;
  Meaning meaning;
};

constexpr Keyword<Pegasus::CIMType> kTypes[] = {
    {"boolean", Pegasus::CIMTYPE_BOOLEAN}, {"uint8", Pegasus::CIMTYPE_UINT8},
    {"sint8", Pegasus::CIMTYPE_SINT8},     {"uint16", Pegasus::CIMTYPE_UINT16},
    {"sint16", Pegasus::CIMTYPE_SINT16},   {"uint32", Pegasus::CIMTYPE_UINT32},
    {"sint32", Pegasus::CIMTYPE_SINT32},   {"uint64", Pegasus::CIMTYPE_UINT64},
    {"sint64", Pegasus::CIMTYPE_SINT64},   {"real32", Pegasus::CIMTYPE_REAL32},
    {"real64", Pegasus::CIMTYPE_REAL64},   {"char16", Pegasus::CIMTYPE_CHAR16},
    {"string", Pegasus::CIMTYPE_STRING},   {"datetime", Pegasus::CIMTYPE_DATETIME}};

constexpr Keyword<MofFlavor> kFlavors[] = {
    {"enableoverride", MofFlavor::enableOverride}, {"disableoverride", MofFlavor::disableOverride},
    {"tosubclass", MofFlavor::toSubclass},         {"restricted", MofFlavor::restricted},
    {"translatable", MofFlavor::translatable},     {"toinstance", MofFlavor::toInstance}};

constexpr Keyword<unsigned> kScopes[] = {
    {"schema", QualifierScope::kSchema},           {"class", QualifierScope::kClass},
    {"association", QualifierScope::kAssociation}, {"indication", QualifierScope::kIndication},
    {"qualifier", QualifierScope::kQualifier},     {"property", QualifierScope::kProperty},
    {"reference", QualifierScope::kReference},     {"method", QualifierScope::kMethod},
    {"parameter", QualifierScope::kParameter},     {"any", QualifierScope::kAny}};

char lowered(char c) {
  return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

template <class Meaning, std::size_t N>
std::optional<Meaning> find(const Keyword<Meaning> (&table)[N], std::string_view name) {
  for (const auto& row : table) {
    if (isMofKeyword(name, row.name)) return row.meaning;
  }
  return std::nullopt;
}

}  // namespace

std::string asciiLowered(std::string text) {
  for (char& c : text) c = lowered(c);
  return text;
}

bool isMofKeyword(std::string_view name, std::string_view keyword) {
  if (name.size() != keyword.size()) return false;
  for (std::size_t i = 0; i < name.size(); ++i) {
    if (lowered(name[i]) != keyword[i]) return false;
  }
  return true;
}

std::optional<Pegasus::CIMType> mofTypeFromKeyword(std::string_view name) {
  return find(kTypes, name);
}

std::optional<MofFlavor> mofFlavorFromKeyword(std::string_view name) {
  return find(kFlavors, name);
}

std::optional<unsigned> mofScopeFromKeyword(std::string_view name) {
  return find(kScopes, name);
}

}  // namespace cimhost
