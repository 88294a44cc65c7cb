#include "CommonRUKTools/FileChange.h"

#include <gtest/gtest.h>

#include <random>

#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"
#include "tests/StepGate.h"
#include "tests/database/SongFolder.h"

#ifndef Q_OS_WIN
#include <sys/stat.h>
#include <sys/xattr.h>
#endif

using namespace Qt::StringLiterals;

namespace {

using Bytes = std::vector<std::uint8_t>;

Bytes Applied(const FilePatch& patch, const Bytes& old) {
    Bytes made;
    for (const FilePatch::Piece& piece : patch.Pieces()) {
        const auto from = old.begin() + piece.From;
        if (piece.IsKept())
            made.insert(made.end(), from, from + piece.Length);
        else
            made.insert(made.end(), piece.Bytes.begin(), piece.Bytes.end());
    }
    return made;
}

class FileChangeTest : public testing::Test {
 protected:
    // A longer head before the same rest.
    static FilePatch LongerHead(qint64 size) {
        FilePatch patch;
        patch.Insert(AsBytes("longer"));
        patch.Keep(3, size - 3);
        return patch;
    }
    static void Patch(const QString& path, const FileState& expected) {
        const PatchPlan plan = PlanPatch(path, LongerHead(6), expected);
        WritePatch(plan);
        FinishPatch(plan);
    }
    static QString ErrorOfPatching(const QString& path, const FileState& expected) {
        return ErrorOf<EStreamError>([&] { Patch(path, expected); });
    }

    SongFolder folder_;
    QString file_ = folder_.Put(u"a"_s, "old123");
};

}  // namespace

TEST(FilePatchTest, EveryPatchCanBeTakenBackAndWrittenDown) {
    std::mt19937 random(1);
    const auto below = [&random](int limit) {
        return static_cast<std::int64_t>(random() % static_cast<unsigned>(limit));
    };
    for (int round = 0; round < 2000; ++round) {
        Bytes old(static_cast<std::size_t>(below(60)));
        for (auto& byte : old)
            byte = static_cast<std::uint8_t>(random());
        FilePatch patch;
        for (std::int64_t i = below(6); i-- > 0;) {
            const std::int64_t from = below(static_cast<int>(old.size()) + 1);
            patch.Keep(from, below(static_cast<int>(old.size()) + 1 - static_cast<int>(from)));
            patch.Insert(
                ByteSpan(old).first(static_cast<std::size_t>(below(static_cast<int>(old.size()) + 1))));
        }
        MemorySource source(old);
        const Bytes made = Applied(patch, old);
        ASSERT_EQ(Applied(patch.Inverse(source), made), old);
        ASSERT_EQ(Applied(patch.Whole(source), old), made);
        ByteWriter writer;
        patch.Write(writer);
        ByteReader reader(writer.Bytes());
        ASSERT_EQ(FilePatch::Read(reader), patch);
    }
    const Bytes old(10);
    MemorySource source(old);
    for (const auto& [from, length] : {std::pair{5, 6}, {-1, 3}, {11, 1}}) {
        FilePatch outside;
        outside.Keep(from, length);
        EXPECT_THROW(outside.Inverse(source), EStreamError);
    }
}

TEST_F(FileChangeTest, WhatAnotherProgramHasMadeOfTheFileStays) {
    const FileState planned = StateOf(file_);
    folder_.Put(u"a"_s, "other1");
    EXPECT_TRUE(ErrorOfPatching(file_, planned).contains(file_));
    EXPECT_EQ(folder_.Get(u"a"_s), "other1");

    const PatchPlan plan = PlanPatch(file_, LongerHead(6), StateOf(file_));
    WritePatch(plan);
    folder_.Put(u"a"_s, "other2");
    EXPECT_THROW(FinishPatch(plan), EFileChanged);
    EXPECT_EQ(folder_.Get(u"a"_s), "other2");
    EXPECT_EQ(QDir(folder_.Path()).entryList(QDir::Files | QDir::Hidden), QStringList(u"a"_s));
}

TEST_F(FileChangeTest, AMoveReplacesNothingAndComparesWhatItCopies) {
    folder_.Put(u"b"_s, "there");
    EXPECT_THROW(MoveFile(file_, folder_.Path(u"b"_s)), EStreamError);
    const MovePlan plan = PlanMove(file_, folder_.Path(u"c/d"_s));
    EXPECT_EQ(plan.Folders, QStringList(folder_.Path(u"c"_s)));
    folder_.Put(u"c/d"_s, "came meanwhile");
    EXPECT_THROW(CarryOutMove(plan), EStreamError);
    EXPECT_EQ(folder_.Get(u"b"_s) + folder_.Get(u"c/d"_s) + folder_.Get(u"a"_s), "therecame meanwhileold123");

    StepGate gate;
    gate.BetweenFileSystems = true;
    const FileState before = StateOf(file_);
    MoveFile(file_, folder_.Path(u"e"_s));
    EXPECT_EQ(folder_.Get(u"e"_s), "old123");
    EXPECT_TRUE(StateOf(folder_.Path(u"e"_s)).HasBytesOf(before));
    EXPECT_FALSE(QFile::exists(file_));
}

#ifndef Q_OS_WIN
TEST_F(FileChangeTest, LinksModeAndAttributesStay) {
    const QString link = folder_.Path(u"link"_s);
    ASSERT_TRUE(QFile::link(u"a"_s, link));
    const QByteArray name = QFile::encodeName(file_);
    ASSERT_EQ(::chmod(name.constData(), 0641), 0);
    const bool hasAttributes = ::setxattr(name.constData(), "user.note", "x", 1, 0) == 0;
    Patch(link, StateOf(link));
    struct stat status {};
    char value = 0;
    ASSERT_EQ(::stat(name.constData(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777U, 0641U);
    EXPECT_TRUE(!hasAttributes ||
                (::getxattr(name.constData(), "user.note", &value, 1) == 1 && value == 'x'));
    EXPECT_TRUE(QFileInfo(link).isSymLink());
    EXPECT_EQ(folder_.Get(u"a"_s), "longer123");

    ASSERT_EQ(::link(name.constData(), QFile::encodeName(folder_.Path(u"second"_s)).constData()), 0);
    const PatchPlan plan = PlanPatch(file_, LongerHead(9), StateOf(file_));
    EXPECT_EQ(plan.OtherNames, 1);
    WritePatch(plan);
    FinishPatch(plan);
    EXPECT_EQ(folder_.Get(u"second"_s), "longerger123");
    TakeBackPatch(plan);
    EXPECT_EQ(folder_.Get(u"second"_s), "longer123");
}

TEST_F(FileChangeTest, ReadOnlyFilesFoldersAndPipesAreRefused) {
    ASSERT_EQ(::mkfifo(QFile::encodeName(folder_.Path(u"pipe"_s)).constData(), 0600), 0);
    EXPECT_TRUE(ErrorOfPatching(folder_.Path(u"pipe"_s), {}).contains(u"pipe"_s));
    EXPECT_NE(ErrorOfPatching(folder_.Path(), StateOf(folder_.Path())), QString());
    ASSERT_EQ(::chmod(QFile::encodeName(file_).constData(), 0444), 0);
    EXPECT_EQ(ErrorOfPatching(file_, StateOf(file_)), u"Die Datei "_s + file_ + u" ist schreibgeschützt."_s);
    EXPECT_EQ(folder_.Get(u"a"_s), "old123");
    const MovePlan plan = PlanMove(file_, folder_.Path(u"b"_s));
    EXPECT_FALSE(CarryOutMove(plan).ReadOnly);
    TakeBackMove(plan);
    EXPECT_TRUE(StateOf(file_).ReadOnly);
}
#endif
