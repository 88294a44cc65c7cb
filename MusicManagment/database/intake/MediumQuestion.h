#pragma once

#include <QStringList>

class TMusicDatabase;

// Before songs are taken in: where files or folders lie on a medium that can be taken away and of which
// nothing is known yet, asks whether it is to be catalogued, and under which name. What the user has once
// called an ordinary folder is not asked about again. Does nothing with the classic rules. Throws EAbort on
// cancel.
void AskAboutMedia(TMusicDatabase& database, const QStringList& paths);
