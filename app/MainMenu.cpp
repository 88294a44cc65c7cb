#include "app/MainMenu.h"

#include <QAction>
#include <QMenu>
#include <QMenuBar>

#include "app/CollectionCommands.h"
#include "app/CommandRunner.h"
#include "app/desktop/Icons.h"

using namespace Qt::StringLiterals;

namespace {

struct Entry {
    const char16_t* Caption;  // nullptr: a separator
    const char16_t* Shortcut;
    const char16_t* Icon;
    void (CollectionCommands::*Run)();
    QStyle::StandardPixmap Substitute;
    char16_t Key;  // the letter of the caption that chooses it in the open menu
};

constexpr Entry kSeparator{};

constexpr Entry kDatabaseMenu[] = {
    {u"Neue Datenbank", u"Ctrl+Alt+N", u"document-new", &CollectionCommands::New, QStyle::SP_FileIcon, u'N'},
    {u"Datenbank öffnen...", u"Ctrl+Alt+O", u"document-open", &CollectionCommands::Open,
     QStyle::SP_DialogOpenButton, u'f'},
    {u"Datenbank speichern", u"Ctrl+Alt+S", u"document-save", &CollectionCommands::Save,
     QStyle::SP_DialogSaveButton, u's'},
    {u"Datenbank speichern unter...", u"", u"document-save-as", &CollectionCommands::SaveAs,
     QStyle::SP_DialogSaveButton, u'u'},
    kSeparator,
    {u"Songs zur Datenbank hinzufügen...", u"", u"audio-x-generic", &CollectionCommands::AddSongs,
     QStyle::SP_FileIcon, u'h'},
    {u"Ordner zur Datenbank hinzufügen...", u"", u"folder-music", &CollectionCommands::AddFolder,
     QStyle::SP_DirIcon, u'O'},
    kSeparator,
};

QString WithKey(QString caption, char16_t key) {
    return caption.insert(caption.indexOf(QChar(key)), u'&');
}

}  // namespace

MainMenu::MainMenu(QMenuBar& bar, CollectionCommands& commands, std::function<void()> exit) {
    QMenu* menu = bar.addMenu(WithKey(u"Datenbank"_s, u'D'));
    for (const Entry& entry : kDatabaseMenu) {
        if (entry.Caption == nullptr) {
            menu->addSeparator();
            continue;
        }
        QAction* action = menu->addAction(ThemeIcon(QString::fromUtf16(entry.Icon), entry.Substitute),
                                          WithKey(QString::fromUtf16(entry.Caption), entry.Key));
        action->setShortcut(QKeySequence(QString::fromUtf16(entry.Shortcut)));
        QObject::connect(action, &QAction::triggered, &bar,
                         [&commands, run = entry.Run] { RunCommand([&] { (commands.*run)(); }); });
        commands_ << action;
    }
    QAction* last = menu->addAction(ThemeIcon(u"application-exit"_s, QStyle::SP_DialogCloseButton),
                                    WithKey(u"Beenden"_s, u'B'));
    last->setShortcut(QKeySequence(u"Ctrl+Q"_s));
    QObject::connect(last, &QAction::triggered, &bar, std::move(exit));
}

void MainMenu::SetCommandsEnabled(bool enabled) {
    for (QAction* action : commands_)
        action->setEnabled(enabled);
}
