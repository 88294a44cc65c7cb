#include <gtest/gtest.h>

#include <QApplication>

#include "CommonRUKTools/CommandRunner.h"
#include "app/desktop/Translations.h"

int main(int argc, char** argv) {
    GuardedApplication<QApplication> application(argc, argv);
    InstallGerman(application);
    testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
