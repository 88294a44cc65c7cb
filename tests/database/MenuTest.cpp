#include "MusicManagment/database/commands/Menu.h"

#include <gtest/gtest.h>

#include "MusicManagment/database/MusicManagment.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

QStringList Captions(const TMenuExItem& menu) {
    QStringList captions;
    for (const auto& item : menu.Items())
        captions << (item->Kind() == TMenuExItem::ItemKind::Separator ? u"-"_s : item->Caption());
    return captions;
}

}  // namespace

TEST(Menu, AReadOnlyDatabaseHasOnlyWhatDoesNotWrite) {
    TMusicDatabase database;
    EXPECT_EQ(database.Menu().Caption(), u"Musik-Datenbank"_s);
    EXPECT_EQ(Captions(database.Menu()),
              (QStringList{u"Datenbank"_s, u"Bearbeiten"_s, u"Song"_s, u"Extras"_s, u"Übersicht"_s}));
    EXPECT_EQ(Captions(*database.Menu().Items()[1]).size(), 12);
    database.SetReadOnly(true);
    EXPECT_EQ(Captions(database.Menu()), (QStringList{u"Bearbeiten"_s, u"Song"_s, u"Übersicht"_s}));
    for (const int id : {221, 222, 223, 224, 311, 403, 404, 501})
        EXPECT_EQ(database.Menu().Find(id), nullptr) << id;
    EXPECT_EQ(Captions(*database.Menu().Items()[2]).size(), 5);
}

TEST(Menu, MarksFollowTheProperties) {
    TMusicDatabase database;
    EXPECT_TRUE(database.Menu().Find(417)->Checked());
    EXPECT_TRUE(database.Menu().Find(431)->Checked());
    EXPECT_TRUE(database.Menu().Find(442)->Checked());
    EXPECT_TRUE(database.Menu().Find(401)->IsDefault());
    EXPECT_TRUE(database.ClickMenuItem(412));
    EXPECT_TRUE(database.ClickMenuItem(433));
    EXPECT_TRUE(database.ClickMenuItem(441));
    EXPECT_EQ(database.SortType(), stArtist);
    EXPECT_EQ(database.SubSortType(), sstPath);
    EXPECT_TRUE(database.Menu().Find(412)->Checked());
    EXPECT_FALSE(database.Menu().Find(417)->Checked());
    EXPECT_TRUE(database.Menu().Find(441)->Checked());
}

TEST(Menu, TheHandlerComesFirstAndCanStopTheCommand) {
    TMusicDatabase database;
    qint64 seen = 0;
    bool allow = false;
    database.OnMenuItemClicked = [&](TMusicDatabase&, const TMenuExItem& item, void*, qint64 id,
                                     bool& proceed) {
        EXPECT_EQ(item.Id(), id);
        seen = id;
        proceed = allow;
    };
    EXPECT_TRUE(database.ClickMenuItem(411));
    EXPECT_EQ(seen, 411);
    EXPECT_EQ(database.SortType(), stGenre);
    allow = true;
    EXPECT_TRUE(database.ClickMenuItem(411));
    EXPECT_EQ(database.SortType(), stTitle);
    EXPECT_FALSE(database.ClickMenuItem(508));
    EXPECT_FALSE(database.ClickMenuItem(9999));
}

TEST(Menu, ARunThatLocksTheMenuDisablesItsCommands) {
    TMusicDatabase database;
    {
        const ProgressRun run(database, u"Test"_s);
        EXPECT_FALSE(database.Menu().Find(101)->Enabled());
        EXPECT_FALSE(database.ClickMenuItem(411));
    }
    EXPECT_TRUE(database.Menu().Find(101)->Enabled());
}
