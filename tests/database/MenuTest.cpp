#include "CommonRUKTools/CommandDispatcher.h"

#include <gtest/gtest.h>

#include "MusicManagment/database/MusicManagment.h"
#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

int CountOf(const TMenuExItem& menu) {
    return static_cast<int>(menu.Items().size());
}

QString ArrangementFault(CommandDispatcher& commands, const QString& file) {
    return ErrorOf([&] { commands.Arrange(ReadMenuFile(file)); });
}

// "101 Neu | - | Ablage ( 103 )"
QString Outline(const TMenuExItem& menu) {
    QStringList items;
    for (const auto& item : menu.Items()) {
        if (item->Kind() == TMenuExItem::ItemKind::Separator)
            items << u"-"_s;
        else if (item->Kind() == TMenuExItem::ItemKind::Submenu)
            items << item->Caption() + u" ( "_s + Outline(*item) + u" )"_s;
        else
            items << QString::number(item->Id()) + u' ' + item->Caption();
    }
    return items.join(u" | "_s);
}

}  // namespace

TEST(Menu, AReadOnlyDatabaseHasOnlyWhatDoesNotWrite) {
    TMusicDatabase database;
    EXPECT_EQ(CountOf(database.Menu()), 5);
    database.SetReadOnly(true);
    EXPECT_EQ(CountOf(database.Menu()), 3);
    for (const int id : {221, 222, 223, 224, 311, 403, 404, 501})
        EXPECT_EQ(database.Menu().Find(id), nullptr) << id;
    EXPECT_EQ(CountOf(*database.Menu().Items()[2]), 5);
}

TEST(Menu, MarksFollowTheProperties) {
    TMusicDatabase database;
    EXPECT_TRUE(database.Menu().Find(417)->Checked() && database.Menu().Find(431)->Checked());
    for (const int id : {412, 433, 441})
        EXPECT_TRUE(database.ClickMenuItem(id));
    EXPECT_EQ(database.SortType(), stArtist);
    EXPECT_EQ(database.SubSortType(), sstPath);
    const TMenuExItem& menu = database.Menu();
    EXPECT_TRUE(menu.Find(412)->Checked() && menu.Find(441)->Checked());
    EXPECT_FALSE(menu.Find(417)->Checked());
}

TEST(Menu, TheEventComesFirstThenTheShellsHandlerThenTheEngine) {
    TMusicDatabase database;
    qint64 seen = 0;
    bool allow = false;
    database.OnMenuItemClicked = [&](TMusicDatabase&, const TMenuExItem&, void*, qint64 id, bool& proceed) {
        seen = id;
        proceed = allow;
    };
    EXPECT_TRUE(database.ClickMenuItem(411));
    EXPECT_EQ(seen, 411);
    EXPECT_EQ(database.SortType(), stGenre);
    allow = true;
    int handled = 0;
    Subscription shell = database.Commands().Handle(411, {.Run = [&] { ++handled; }});
    EXPECT_TRUE(database.ClickMenuItem(411));
    EXPECT_EQ(handled, 1);
    EXPECT_EQ(database.SortType(), stGenre);
    shell.End();
    EXPECT_TRUE(database.ClickMenuItem(411));
    EXPECT_EQ(database.SortType(), stTitle);
    // Nobody does it: the item says so.
    EXPECT_FALSE(database.ClickMenuItem(508) || database.Menu().Find(508)->Enabled());
    EXPECT_FALSE(database.Menu().Find(508)->Hint().isEmpty());
    EXPECT_FALSE(database.ClickMenuItem(9999));
}

TEST(Menu, IsShownAsTheUserHasArrangedIt) {
    TMusicDatabase database;
    CommandDispatcher& commands = database.Commands();
    const Subscription own = commands.Add({.Id = 9000, .Caption = u"Beenden"_s}, {.Run = [] {}});
    EXPECT_EQ(&commands.ShownMenu(), &database.Menu());
    EXPECT_EQ(ArrangementFault(commands,
                               u"# mine\r\n"
                               "Datei {\n  101 Neue Sammlung\n  -\n  9000\n}\n"
                               "Ordnung {\n  -\n  Songs {\n 412\n }\n  -\n  221\n -\n}\n"_s),
              QString());
    EXPECT_EQ(Outline(commands.ShownMenu()),
              u"Datei ( 101 Neue Sammlung | - | 9000 Beenden ) | "
              "Ordnung ( Songs ( 412 Artist ) | - | 221 Markierte aus der Datenbank entfernen )"_s);
    // The menu that other parts know stays, and what it holds can be run.
    EXPECT_TRUE(database.ClickMenuItem(413));
    EXPECT_TRUE(database.ClickMenuItem(412) && commands.ShownMenu().Find(412)->Checked());
    database.SetReadOnly(true);
    EXPECT_EQ(Outline(commands.ShownMenu()), u"Datei ( 9000 Beenden ) | Ordnung ( Songs ( 412 Artist ) )"_s);
}

TEST(Menu, AFaultInTheUsersArrangementIsToldWithItsLine) {
    TMusicDatabase database;
    CommandDispatcher& commands = database.Commands();
    const std::pair<QString, QString> cases[] = {
        {u"A {\n412\n"_s, u"Zeile 1: Das Menü „A“ hat kein Ende."_s},
        {u"A {\n412\n}\n}"_s, u"Zeile 4: Hier ist kein Menü offen."_s},
        {u"\n{\n}"_s, u"Zeile 2: Das Menü hat keinen Namen."_s},
        {u"A {\nB\n}"_s, u"Zeile 2: \"B\" ist weder die Nummer eines Befehls noch ein Menü."_s},
        {u"A {\n99999999999\n}"_s,
         u"Zeile 2: \"99999999999\" ist weder die Nummer eines Befehls noch ein Menü."_s},
        {u"A {\n4711\n}"_s, u"Zeile 2: Den Befehl 4711 gibt es nicht."_s},
        {u"A {\n412\nB {\n412\n}\n}"_s, u"Zeile 4: Der Befehl 412 steht schon in Zeile 2."_s},
        {u"412"_s, u"Zeile 1: Das steht in keinem Menü."_s},
        {u"A {"_s.repeated(1000).replace(u"{"_s, u"{\n"_s),
         u"Zeile 9: Die Menüs sind zu tief geschachtelt."_s},
    };
    for (const auto& [file, fault] : cases)
        EXPECT_EQ(ArrangementFault(commands, file), fault) << file.toStdString();
    EXPECT_EQ(&commands.ShownMenu(), &database.Menu());
}

TEST(Menu, ARunThatLocksTheMenuDisablesItsCommandsButNotTheOneThatStays) {
    TMusicDatabase database;
    const Subscription own = database.Commands().Add(
        {.Id = 9000, .Caption = u"Beenden"_s, .Then = ShellCommand::DuringRuns::Stays}, {.Run = [] {}});
    {
        const ProgressRun run(database, u"Test"_s);
        EXPECT_FALSE(database.Menu().Find(101)->Enabled() || database.ClickMenuItem(411));
        EXPECT_TRUE(database.Menu().Find(9000)->Enabled() && database.ClickMenuItem(9000));
    }
    EXPECT_TRUE(database.Menu().Find(101)->Enabled());
}
