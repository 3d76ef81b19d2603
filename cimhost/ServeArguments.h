#pragma once

#include "cimhost/ServeOptions.h"

namespace CLI {
class App;
}

namespace cimhost {

/// Adds the options of `serve` to its command; their values go to `options`.
void addServeArguments(CLI::App& command, ServeOptions& options);

/// Throws CLI::ValidationError for options that do not go together.
void requireUsable(const ServeOptions& options);

}  // namespace cimhost
