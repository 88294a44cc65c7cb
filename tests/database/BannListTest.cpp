#include "MusicManagment/database/intake/BannList.h"

#include <gtest/gtest.h>

#include <QFile>
#include <QTemporaryDir>

#include "CommonRUKTools/Errors.h"
#include "MusicManagment/database/MusicManagment.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

class BannListTest : public testing::Test {
 protected:
    QString Path() const { return folder_.filePath(u"Tunestead3_BannList.str"_s); }
    void Write(const QByteArray& text) const {
        QFile file(Path());
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(text);
    }
    QByteArray Written() const {
        QFile file(Path());
        return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
    }
    static QStringList Entries(const SortedTextList& list) {
        QStringList entries;
        for (const auto& row : list)
            entries << row.Text;
        return entries;
    }

    QTemporaryDir folder_;
    SortedTextList list_;
};

TEST_F(BannListTest, ComesBackAsItWasSaved) {
    const QStringList entries = {u"Die Ärzte - Zu spät"_s, u" - "_s, u"日本 - 音楽 "_s};
    for (const QString& entry : entries)
        list_.Insert(entry);
    SaveBannList(list_, Path());
    EXPECT_EQ(Written().count("\r\n"), 3);
    SortedTextList loaded;
    loaded.Insert(u"of an earlier list"_s);
    LoadBannList(loaded, Path());
    EXPECT_EQ(Entries(loaded), Entries(list_));

    list_.Clear();
    SaveBannList(list_, Path());
    LoadBannList(loaded, Path());
    EXPECT_EQ(loaded.Count(), 0);
}

TEST_F(BannListTest, TakesAnyLineEndAndBothCodePages) {
    struct Case {
        QByteArray Text;
        QStringList Entries;
    };
    const Case cases[] = {{"A - 1\r\nB - 2\r\n", {u"A - 1"_s, u"B - 2"_s}},
                          {"A - 1\nB - 2", {u"A - 1"_s, u"B - 2"_s}},
                          {"\rB - 2\r\r\n\nA - 1", {u"A - 1"_s, u"B - 2"_s}},
                          {"A - 1\r\nA - 1\r\n", {u"A - 1"_s}},
                          {"\xEF\xBB\xBF\xC3\x84 - 1", {u"Ä - 1"_s}},
                          {"A - \xC4\r\nB - \xC3\x84", {u"A - Ä"_s, u"B - Ä"_s}},
                          {"\r\n", {}},
                          {"", {}}};
    for (const Case& each : cases) {
        Write(each.Text);
        LoadBannList(list_, Path());
        EXPECT_EQ(Entries(list_), each.Entries) << each.Text.toStdString();
    }
}

TEST_F(BannListTest, AFileThatCannotBeReadOrWrittenLeavesEverythingAsItWas) {
    list_.Insert(u"A - 1"_s);
    EXPECT_THROW(LoadBannList(list_, Path()), EStreamError);
    EXPECT_THROW(LoadBannList(list_, folder_.path()), EStreamError);
    EXPECT_EQ(list_.Count(), 1);
    EXPECT_THROW(SaveBannList(list_, folder_.filePath(u"missing/list.str"_s)), EStreamError);
}

// A tag may hold a line break, a line of the file cannot.
TEST_F(BannListTest, ASongWithALineBreakStaysBannedAfterLoading) {
    TID3Tag song;
    song.Artist = u"Two\r\nLines"_s;
    song.Title = u"Title\n"_s;
    list_.Insert(BanEntry(song));
    SaveBannList(list_, Path());
    TMusicDatabase database;
    LoadBannList(database.BannList(), Path());
    EXPECT_EQ(database.BannList().Count(), 1);
    EXPECT_TRUE(database.IsBanned(song));
}

}  // namespace
