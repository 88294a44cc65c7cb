#pragma once

class QProcess;

// A program that is started together with everything that it starts itself.

// Before it is started, by a thread that stays until it ends: the program goes with it.
void GiveOwnGroup(QProcess& process);
// Ends the program and what it has started, at once.
void KillGroup(QProcess& process);
