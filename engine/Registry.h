#pragma once

#include "engine/ProviderDefFunction.h"
#include "engine/ProviderDefFunctionCall.h"
#include "engine/ProviderDefModule.h"

#include <cstddef>
#include <memory>
#include <string>
#include <vector>

// The process-wide registries of modules and functions.
//
// They own their objects; a pointer stays valid until the release. No lock is taken: they are
// filled while definition files are read, before any request, and emptied after the last one.

/// Finds a registered module by its exact, case-sensitive name; the first one wins. nullptr (noted
/// at level 9 on standard output) when there is none. Takes constant time.
ProviderDefModule* getModule(const std::string& name);

/// The same for functions.
ProviderDefFunction* getFunction(const std::string& name);

/// The registered modules in order of registration.
const std::vector<std::unique_ptr<ProviderDefModule>>& registeredModules();

ProviderDefModule* registerModule(std::unique_ptr<ProviderDefModule> module);
ProviderDefFunction* registerFunction(std::unique_ptr<ProviderDefFunction> function);

/// Registers a function whose name is new; gives the registered function of that name, which is the
/// first one that was declared.
ProviderDefFunction* registerNewFunction(std::unique_ptr<ProviderDefFunction> function);

/// Keeps a module's initialisation call until releaseModules(): a call may outlive the module
/// object that was read with it, since a registered module of the same name can take it over.
ProviderDefFunctionCall* keepInitCall(std::unique_ptr<ProviderDefFunctionCall> call);

/// The registered functions in order of registration.
const std::vector<std::unique_ptr<ProviderDefFunction>>& registeredFunctions();

/// How many functions are registered.
size_t functionCount();

/// Gives the functions registered at position `first` and later that refer to module `from` the
/// module `to`.
void replaceModule(const ProviderDefModule* from, ProviderDefModule* to, size_t first);

/// Destroys every registered function.
void releaseFunctions();

/// Destroys every registered module, which closes its library, and empties the class and
/// association lists. Call releaseFunctions() first.
void releaseModules();

/// Empties the class and the association list. The definition registries implement it.
void releaseDefinitions();
