#pragma once

#include <string>
#include <string_view>

/// Ends the process with `problem` unless `good`: a fuzzer then keeps the input.
void check(bool good, const char* problem);

/// Ends the process unless the text is well-formed XML.
void checkWellFormed(std::string_view text);
