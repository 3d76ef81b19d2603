#pragma once

#include <string>

namespace cimhost {

/// Tells the service manager about this process (sd_notify(3)): `state` is a list of lines such as
/// READY=1. Does nothing when NOTIFY_SOCKET is not set; a message that cannot be delivered is lost.
void notifyServiceManager(const std::string& state);

/// RELOADING=1 with the time that it must carry; READY=1 ends it.
std::string reloadingState();

}  // namespace cimhost
