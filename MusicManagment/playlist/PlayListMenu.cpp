#include "MusicManagment/playlist/PlayListMenu.h"

#include "CommonRUKTools/CommandDispatcher.h"
#include "MusicManagment/playlist/PlayList.h"

namespace {

constexpr MenuLine kLines[] = {
    pcNew,      pcOpen,           pcSave,        pcSaveAs,           pcExportAsLinks,
    kSeparator, pcRemoveSelected, pcMarkCurrent, pcRemoveUnavailable};
constexpr MenuOutline kMenu{u"PlayList", kLines};

}  // namespace

CommandDispatcher& TPlayList::Commands() {
    if (commands_) return *commands_;
    commands_ = std::make_unique<CommandDispatcher>(kMenu);
    for (const PlayListCommands& capability : {kListFileCommands, kEntryCommands})
        commands_->Register(*this, capability);
    return *commands_;
}

TMenuExItem& TPlayList::Menu() {
    return Commands().Menu();
}

bool TPlayList::ClickMenuItem(int id) {
    return Commands().Run(id);
}
