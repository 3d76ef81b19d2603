#include <Pegasus/Common/CIMType.h>

PEGASUS_NAMESPACE_BEGIN

const char* cimTypeToString(const CIMType type) {
  static const char* const kNames[] = {"boolean", "uint8",   "sint8",  "uint16",   "sint16",
                                       "uint32",  "sint32",  "uint64", "sint64",   "real32",
                                       "real64",  "char16",  "string", "datetime", "reference",
                                       "object",  "instance"};
  static_assert(sizeof kNames / sizeof *kNames == CIMTYPE_INSTANCE + 1, "one name per type");
  const auto index = static_cast<unsigned>(type);
  return index < sizeof kNames / sizeof *kNames ? kNames[index] : "";
}

PEGASUS_NAMESPACE_END
