#pragma once

#include "MusicManagment/database/intake/Intake.h"

// Tells the user what came of a change of the collection, and shows the details when asked to: they are
// written to a text file in the temporary folder, which is opened with the program that the user has chosen
// for texts.
void ShowReport(const QString& message, const QString& details);
void ReportIntake(const IntakeResult& result);
