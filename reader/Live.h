#pragma once

#include "reader/Commands.h"

namespace tavro {

/// The reader as one uses it: key presses move, activate and adjust, and what is heard comes a line
/// each. Ends with "q" or the end of the input; the exit code after a signal is 128 and its number.
int readLive(const Command& command);

}  // namespace tavro
