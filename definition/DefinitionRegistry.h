#pragma once

#include "association/ProviderDefAssociation.h"
#include "engine/ProviderDefClass.h"

#include <deque>

// The process-wide lists of classes and associations, in reading order. They own their entries; a
// pointer to one stays valid until releaseDefinitions(). No lock is taken: they are filled before any
// request and read-only until the release.

const std::deque<ProviderDefClass>& registeredClasses();

/// Builds a class, or an association, from its element and registers it. What throws registers
/// nothing. The arguments are those of the element's constructor.
void registerClass(const char* text, int length, int* consumed, ProviderDefModule* module);
void registerAssociation(const char* text, int length, int* consumed, ProviderDefModule* module);
