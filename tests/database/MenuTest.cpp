#include "CommonRUKTools/CommandDispatcher.h"

#include <gtest/gtest.h>

#include "MusicManagment/database/MusicManagment.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

int CountOf(const TMenuExItem& menu) {
    return static_cast<int>(menu.Items().size());
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
