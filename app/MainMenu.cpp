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
    char16_t Key;             // the letter of the caption that chooses it in the open menu
    const char16_t* Shortcut;
    const char16_t* Icon;
    QStyle::StandardPixmap Substitute;
    void (CollectionCommands::*Run)();
};

constexpr Entry kSeparator{nullptr, 0, nullptr, nullptr, QStyle::SP_CustomBase, nullptr};

constexpr Entry kDatabaseMenu[] = {
    {u"Neue Datenbank", u'N', u"Ctrl+Alt+N", u"document-new", QStyle::SP_FileIcon, &CollectionCommands::New},
    {u"Datenbank öffnen...", u'f', u"Ctrl+Alt+O", u"document-open", QStyle::SP_DialogOpenButton,
     &CollectionCommands::Open},
    {u"Datenbank speichern", u's', u"Ctrl+Alt+S", u"document-save", QStyle::SP_DialogSaveButton,
     &CollectionCommands::Save},
    {u"Datenbank speichern unter...", u'u', u"", u"document-save-as", QStyle::SP_DialogSaveButton,
     &CollectionCommands::SaveAs},
    kSeparator,
    {u"Songs zur Datenbank hinzufügen...", u'h', u"", u"audio-x-generic", QStyle::SP_FileIcon,
     &CollectionCommands::AddSongs},
    {u"Ordner zur Datenbank hinzufügen...", u'O', u"", u"folder-music", QStyle::SP_DirIcon,
     &CollectionCommands::AddFolder},
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
