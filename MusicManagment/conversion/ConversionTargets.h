#pragma once

#include <QSet>
#include <QString>

#include "MusicManagment/conversion/EncoderSettings.h"

// Names of the files that a conversion makes. No two are the same, and none is that of its source.
class ConversionTargets {
 public:
    explicit ConversionTargets(MusicFormat format) : extension_(ExtensionOf(format)) {}

    // In the folder, which is that of the source where it is empty: the source's name with the format's
    // ending, with a number (" (2)") behind it where another source of this conversion has that name.
    QString For(const QString& source, const QString& folder = {});
    // The same for a name that is settled but for its ending.
    QString Instead(const QString& path);

 private:
    // Where the name would be `own`, any file that has it makes way to a number, too.
    QString Free(const QString& base, const QString& own);

    QString extension_;
    QSet<QString> taken_;
};
