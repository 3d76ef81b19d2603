#include <Pegasus/Embedded/Shareable.h>

PEGASUS_NAMESPACE_BEGIN

// Out of line: the type information must exist once in the process.
Shareable::~Shareable() = default;

PEGASUS_NAMESPACE_END
