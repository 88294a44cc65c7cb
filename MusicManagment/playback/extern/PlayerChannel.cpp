#include "MusicManagment/playback/extern/PlayerChannel.h"

#include <QStandardPaths>

#include "CommonRUKTools/PrivateFolder.h"

using namespace Qt::StringLiterals;

namespace {

// Class and title, by which the player program has always been found.
constexpr QStringView kName = u"TTSPlayerWnd.TS Player";

}  // namespace

QString PlayerChannelPath() {
    const QString runtime = QStandardPaths::writableLocation(QStandardPaths::RuntimeLocation);
    const QString folder = runtime + u"/tunestead"_s;
    if (runtime.isEmpty() || !MakePrivateFolder(folder)) return {};
    return folder + u'/' + kName.toString();
}
