#pragma once

#include "association/ProviderDefAssociation.h"
#include "engine/ProviderDefClass.h"

#include <deque>

// The process-wide lists of classes and associations, in reading order. They own their entries; a
// pointer to one stays valid until releaseDefinitions(). No lock is taken: they are filled before
// any request and read-only until the release.

const std::deque<ProviderDefClass>& registeredClasses();

/// Builds a class, or an association, from the element at which `reader` stands and registers it;
/// the reader is left at the end tag. What throws registers nothing.
void registerClass(ElementReader& reader, ProviderDefModule* module);
void registerAssociation(ElementReader& reader, ProviderDefModule* module);
