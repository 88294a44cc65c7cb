#pragma once

class QProcess;

// A program that is started together with everything that it starts itself.

// Before it is started.
void GiveOwnGroup(QProcess& process);
// Ends the program and what it has started, at once.
void KillGroup(QProcess& process);
