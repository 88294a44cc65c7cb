#pragma once

#include <QString>

#include "MusicManagment/database/SongTypes.h"

// The heading of a run: what it is doing.
QString ProgressHeading(TProgressType type);
// "3 von 12", with a description "3 von 12 - Musik"; while the maximum is unknown (0) the description alone.
QString ProgressLabel(qint64 current, qint64 maximum, const QString& description = QString());
// "Tunestead - 25 %"; a percentage of -1 is unknown.
QString ProgressTitle(int percent);
