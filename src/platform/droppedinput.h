#pragma once

/// Keys and clicks that press nothing: those that arrive while the program does not answer, and the
/// repetitions of a key that is held down.

class QEvent;
class QObject;

/// To be asked before the toolkit handles an event: a press that is dropped later, by a filter, has
/// moved the focus.
bool isDropped(const QObject *receiver, const QEvent *event);

/// Drops the keys and clicks that have arrived and were not answered yet.
void dropPendingInput();
