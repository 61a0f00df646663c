#pragma once

namespace snapshot {

/// Thrown where a signal asked the program to end.
struct Interrupted {};

/// From now on the signals that ask a program to end are waited for by `throwIfInterrupted`; those that are ignored
/// stay so. A second one ends the program.
void catchInterruptions();

void throwIfInterrupted();

} // namespace snapshot
