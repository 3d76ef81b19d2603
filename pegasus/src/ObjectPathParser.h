#pragma once

#include <Pegasus/Common/CIMObjectPath.h>

PEGASUS_NAMESPACE_BEGIN

/// The parts of an object path as text; keys sorted, their references in canonical form.
struct ObjectPathParts {
  String host;
  CIMNamespaceName nameSpace;
  CIMName className;
  Array<CIMKeyBinding> keyBindings;
};

/// Parses a text, up to its first unit 0, into `parts`, which is empty before. Returns whether it
/// is a path; if not, `parts` holds what came before the mistake and `reason`, unless null, says
/// why. Throws std::bad_alloc only.
///
/// Recurses into quoted values that are paths themselves. Each level of quotes doubles the
/// backslashes of the next, so the depth is at most the logarithm of the length.
bool parseObjectPath(const String& text, ObjectPathParts& parts, String* reason = nullptr);

/// The text of a path, as parseObjectPath() reads it.
String formatObjectPath(const ObjectPathParts& parts);

/// Host, namespace and class ignoring case, then the keys by position.
bool identicalPaths(const ObjectPathParts& x, const ObjectPathParts& y);

/// Sorts by name, ignoring case, and keeps the order of equal names; un-shares only when needed.
void sortKeyBindings(Array<CIMKeyBinding>& keyBindings);

/// `0`, decimal digits without a leading zero or `0x` with hexadecimal digits, within 64 bits.
bool parseUnsigned(const String& text, Uint64& number);

/// The same with an optional sign, within Sint64.
bool parseSigned(const String& text, Sint64& number);

PEGASUS_NAMESPACE_END
