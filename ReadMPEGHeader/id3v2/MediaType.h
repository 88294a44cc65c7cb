#pragma once

#include <QString>

// German text of a "TMED" frame: references in parentheses "(MC/4)" or bare codes "VID/PAL/VHS", each code
// replaced by its text ("Kassette, 4,75 cm/s"). Whatever is no known code stays as it stands.
QString MediaTypeText(const QString& text);
