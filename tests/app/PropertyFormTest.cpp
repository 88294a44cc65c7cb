#include "app/views/PropertyForm.h"

#include <gtest/gtest.h>

#include <QBuffer>
#include <QClipboard>
#include <QFile>
#include <QMainWindow>
#include <QTemporaryDir>
#include <QTest>

#include "MusicManagment/database/MusicManagment.h"
#include "app/ToolWindows.h"
#include "app/views/CoverView.h"
#include "app/views/PropertyTree.h"
#include "tests/PrintQt.h"
#include "tests/ReadMPEGHeader/Builders.h"
#include "tests/app/Songs.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

class PropertyFormTest : public testing::Test {
 protected:
    PropertyFormTest() {
        database_.SetModernTags(true);
        form_.resize(400, 600);
    }

    // With a tag and some sound.
    TID3Tag Song(const QString& name, const Bytes& tag) const {
        const Bytes file = Mp3Builder().Raw(tag).Frames(80).Data();
        return database_.GetEntry(-1, folder_.Put(name, ByteSpan(file)));
    }
    TID3Tag TaggedSong() const {
        return Song(u"lied.mp3"_s,
                    TitledTag("Lied", "Band").Text("TALB", "Das Album").Text("TYER", "1999").Build());
    }
    void Show(const TID3Tag& song) {
        form_.show();
        form_.ShowSong(&song);
    }
    QStringList Lines() const { return form_.Properties().AllText().split(u'\n'); }

    SongFolder folder_;
    TMusicDatabase database_;
    mutable TPropertyForm form_{database_};
};

TEST_F(PropertyFormTest, ShowsWhatIsKnownAtOnceAndTheFileLater) {
    TID3Tag song = TaggedSong();
    song.AddTime = 45292.5;
    song.PlayCount = 12;
    Show(song);
    for (const QString& line :
         {u"Name: lied.mp3"_s, u"Ordner: "_s + folder_.Path(), u"Größe: …"_s, u"Album: Das Album"_s,
          u"Bitrate: 128 KBit/s"_s, u"Beliebtheit: 12"_s, u"Hinzugefügt am: 01.01.2024 12:00"_s})
        EXPECT_TRUE(Lines().contains(line)) << line.toStdString();
    EXPECT_FALSE(Lines().contains(u"ID3v2-Frames"_s));
    EXPECT_TRUE(form_.ReadPending());

    form_.ReadFile();
    EXPECT_FALSE(form_.ReadPending());
    const QString size = QLocale(QLocale::German).toString(QFileInfo(song.FileName).size());
    EXPECT_EQ(Lines().filter(u"Größe: "_s).filter(size + u" Bytes"_s).size(), 1);
    EXPECT_TRUE(Lines().contains(u"TALB: Das Album"_s));
}

TEST_F(PropertyFormTest, ShowsTheCoverReduced) {
    QByteArray png;
    QBuffer buffer(&png);
    QImage picture(1200, 300, QImage::Format_RGB32);
    picture.fill(Qt::red);
    ASSERT_TRUE(picture.save(&buffer, "PNG"));
    const auto withCover = [&](const QString& name, const QByteArray& bytes) {
        auto tag = TitledTag("Lied", "Band");
        tag.Frame("APIC", std::string("\0image/png\0\3\0", 13) + bytes.toStdString());
        return Song(name, tag.Build());
    };
    const auto& cover = *static_cast<CoverView*>(form_.findChild<QWidget*>(u"cover"_s));
    Show(withCover(u"a.mp3"_s, png));
    EXPECT_FALSE(cover.isVisible());
    form_.ReadFile();
    EXPECT_TRUE(cover.isVisible());
    EXPECT_EQ(cover.Image().size(), QSize(600, 150));
    EXPECT_EQ(cover.Image().pixelColor(300, 75), QColor(Qt::red));

    Show(withCover(u"b.mp3"_s, png.first(png.size() / 2).replace(8, 30, QByteArray(30, 'x'))));
    form_.ReadFile();
    EXPECT_FALSE(cover.isVisible());
    EXPECT_TRUE(Lines().contains(u"TIT2: Lied"_s));
}

TEST_F(PropertyFormTest, ReadsNothingWhileItCannotBeSeen) {
    const TID3Tag song = TaggedSong();
    form_.ShowSong(&song);
    EXPECT_FALSE(form_.ReadPending());
    form_.show();
    EXPECT_TRUE(form_.ReadPending());
    form_.hide();
    EXPECT_FALSE(form_.ReadPending());
    form_.show();
    EXPECT_TRUE(form_.ReadPending());
    form_.ReadFile();
    form_.ShowSong(&song);  // the same again
    EXPECT_FALSE(form_.ReadPending());
    form_.ShowSong(nullptr);
    EXPECT_FALSE(form_.ReadPending());
    EXPECT_EQ(form_.Properties().topLevelItemCount(), 0);
}

TEST_F(PropertyFormTest, AnUnreadableFileIsToldInALine) {
    Show(CdSong(u"Lied"_s));
    EXPECT_TRUE(Lines().contains(u"Name: Lied.mp3"_s));
    EXPECT_TRUE(Lines().contains(u"Ordner: :00000001:"_s));
    form_.ReadFile();
    EXPECT_TRUE(Lines().contains(u"Fehler: CD nicht eingelegt"_s));
    EXPECT_TRUE(Lines().filter(u"Größe"_s).isEmpty());

    TID3Tag song;
    song.FileName = folder_.Path();  // a folder can be opened by nobody as a song
    Show(song);
    form_.ReadFile();
    EXPECT_EQ(Lines().filter(u"Fehler: "_s).size(), 1);
}

TEST_F(PropertyFormTest, ChosenLinesAreCopied) {
    Show(TaggedSong());
    PropertyTree& tree = form_.Properties();
    QTreeWidgetItem* tags = tree.topLevelItem(1);
    tags->child(0)->setSelected(true);
    tags->child(2)->setSelected(true);
    QTest::keyClick(&tree, Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(QGuiApplication::clipboard()->text(), u"Titel: Lied\nAlbum: Das Album"_s);

    tree.clearSelection();
    tags->setSelected(true);
    EXPECT_TRUE(tree.ChosenText().startsWith(u"Tags\nTitel: Lied\nArtist: Band\n"_s));
}

TEST_F(PropertyFormTest, FoldedHeadingsStayFolded) {
    Show(TaggedSong());
    form_.Properties().topLevelItem(1)->setExpanded(false);
    TID3Tag other = TaggedSong();
    other.Title = u"Anderes"_s;
    Show(other);
    EXPECT_TRUE(form_.Properties().topLevelItem(0)->isExpanded());
    EXPECT_FALSE(form_.Properties().topLevelItem(1)->isExpanded());
}

TEST(ToolWindows, ThePropertiesFollowTheirSong) {
    TMusicDatabase database;
    TID3Tag song = CdSong(u"Lied"_s);
    database.AddEntry(QString(), song);
    QMainWindow window;
    ToolWindows tools(window, database);
    auto* form = static_cast<TPropertyForm*>(window.findChild<QDockWidget*>(u"PropertyForm"_s));
    window.show();
    form->show();
    const auto shows = [&](const QString& line) { return form->Properties().AllText().contains(line); };
    tools.ShowSong(&database.Song(0));
    EXPECT_TRUE(shows(u"Titel: Lied"_s));
    song.Title = u"Anders"_s;
    database.UpdateEntry(0, song);
    EXPECT_TRUE(shows(u"Titel: Anders"_s));
    database.Clear();
    EXPECT_EQ(form->Properties().topLevelItemCount(), 0);
}

}  // namespace
