#include "app/dialogs/options/RemoteControlPage.h"

#include <QCheckBox>
#include <QFormLayout>

#include "MusicManagment/database/commands/DatabaseSettings.h"
#include "app/desktop/Icons.h"

using namespace Qt::StringLiterals;

RemoteControlPage::RemoteControlPage(const TMusicDatabase& database)
    : OptionsPage(u"Fernsteuerung"_s, ThemeIcon(u"network-connect"_s, QStyle::SP_DriveNetIcon)) {
    QFormLayout& group = AddGroup(u"Andere Programme"_s);
    auto* enabled =
        AddCheck(group, u"RCEnabled"_s, u"Andere Programme &dürfen Tunestead steuern"_s,
                 u"Andere Programme Ihres Rechners können dann den Player und die PlayList bedienen."_s);
    fields_.Bind(enabled, DatabaseSettings::kRCEnabled);
    SetAvailable(
        group, database.RemoteControl() != nullptr,
        u"Hier gibt es keinen Nachrichten-Bus der Sitzung (D-Bus), über den andere Programme es könnten."_s);
}
