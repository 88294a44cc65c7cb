#include "CommonRUKTools/BurningPrograms.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

TEST(BurningPrograms, TheFirstThatIsInstalledGetsTheFolderInItsOwnWay) {
    const QString folder = u"/tmp/Für CD & \"mehr\""_s;
    QStringList installed;
    const auto find = [&](const QString& program) {
        return installed.contains(program) ? u"/usr/bin/"_s + program : QString();
    };
    EXPECT_FALSE(FindBurningProgram(folder, find));
    const std::pair<QString, QStringList> cases[] = {
        {u"xfburn"_s, {u"--data-composition"_s, folder}},
        {u"k3b"_s, {u"--data"_s, folder}},
        {u"brasero"_s, {u"--data"_s, u"file:///tmp/F%C3%BCr%20CD%20&%20%22mehr%22"_s}}};
    for (const auto& [program, arguments] : cases) {
        installed << program;
        const auto call = FindBurningProgram(folder, find);
        ASSERT_TRUE(call);
        EXPECT_EQ(call->Program, u"/usr/bin/"_s + program);
        EXPECT_EQ(call->Arguments, arguments);
    }
}
