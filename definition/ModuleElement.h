#pragma once

#include "definition/ElementReader.h"

class ProviderDefModule;

/// Reads the `module` element that is the current unit and goes past it; gives the registered
/// module.
///
/// A new name is registered. A known one stands for the module registered before, which takes over
/// this one's initialisation call when it has none itself.
ProviderDefModule* readModule(ElementReader& reader);
