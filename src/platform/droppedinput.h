#pragma once

/// Keys and clicks that press nothing: those that arrive while the program does not answer, and the
/// repetitions of a key that is held down.

/// Drops the keys and clicks that have arrived and were not answered yet.
void dropPendingInput();

/// From here on a key that is held down presses a button once.
void dropRepeatedPresses();
