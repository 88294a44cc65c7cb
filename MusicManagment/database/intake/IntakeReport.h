#pragma once

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/intake/Intake.h"

// Tells the user what came of a change of the collection; sections without a line are left out. As a text the
// details are written to a file in the temporary folder, which is opened with the program that the user has
// chosen for texts.
void ShowReport(const QString& message, std::vector<ReportSection> sections, const QString& details);
std::vector<ReportSection> IntakeSections(const IntakeResult& result);
void ReportIntake(const IntakeResult& result);
