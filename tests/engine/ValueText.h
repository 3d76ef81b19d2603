#pragma once

#include "engine/ProviderDefValue.h"

#include <initializer_list>
#include <iosfwd>
#include <string>
#include <vector>

using Values = std::vector<ProviderDefValue>;
using Ints = std::vector<int>;
using Texts = std::vector<std::string>;

/// One value of each type code from 0 on, none of them zero or empty.
const Values& oneOfEachType();

/// Type code and content, for example `2 {1, 2}`: what tests compare where equal() cannot.
std::string valueText(const ProviderDefValue& value);
std::string valueText(const Values& values);

/// Words of 32 bits as packed buffers hold them: low byte first.
std::string words(std::initializer_list<int> list);

void PrintTo(const ProviderDefValue& value, std::ostream* stream);
