#pragma once

#include <Pegasus/Common/Config.h>

PEGASUS_NAMESPACE_BEGIN

/// Placeholder for the language list of a request or response; always empty.
class PEGASUS_COMMON_LINKAGE ContentLanguageList {};

PEGASUS_NAMESPACE_END
