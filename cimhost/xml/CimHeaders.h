#pragma once

#include "cimhost/xml/CimMessage.h"
#include "cimhost/xml/CimXmlService.h"

namespace cimhost {

/// The headers that need no look at the body: CIMOperation, CIMBatch, CIMProtocolVersion. Throws
/// HttpError (DSP0200, 7.3).
void checkHeaders(const CimXmlRequest& request);

/// CIMMethod, CIMObject and CIMProtocolVersion must say what the message says. Clients write the
/// first two as they are or with percent escapes. Throws HttpError with header-mismatch.
void compareHeaders(const CimXmlRequest& request, const CimMessage& message);

}  // namespace cimhost
