#pragma once

class QWidget;

// Shows the handbook, which is part of the program, in a window of its own; one that is open already comes to
// the front.
void ShowHandbook(QWidget& parent);
