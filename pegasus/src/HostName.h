#pragma once

#include <Pegasus/Common/String.h>

PEGASUS_NAMESPACE_BEGIN

/// A dotted host name or IPv4 address, or an IPv6 address in brackets, then an optional port. The
/// text ends at a unit 0.
bool isLegalHost(const String& host);

PEGASUS_NAMESPACE_END
