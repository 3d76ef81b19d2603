#pragma once

#include "cimhost/xml/CimXmlService.h"

#include <string>

namespace cimhost {

/// A request that the transport answers itself.
struct Rejection {
  int status = 0;
  std::string reason;  ///< The body, as one line of text; also in the log.
  HttpHeaders headers;
};

}  // namespace cimhost
