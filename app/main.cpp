#include <QApplication>
#include <QCommandLineParser>

#include "app/MainWindow.h"
#include "app/desktop/Icons.h"
#include "app/desktop/StandardFiles.h"
#include "app/desktop/Translations.h"
#include "app/dialogs/QtDialogs.h"

using namespace Qt::StringLiterals;

namespace {

QStringList FilesOfCommandLine(const QApplication& application) {
    QCommandLineParser parser;
    parser.setApplicationDescription(u"Verwaltet eine Musiksammlung."_s);
    parser.addHelpOption();
    parser.addVersionOption();
    parser.addPositionalArgument(
        u"dateien"_s, u"Ordner und Songs, die aufgenommen werden, oder eine Datenbank"_s, u"[dateien...]"_s);
    parser.process(application);
    return parser.positionalArguments();
}

}  // namespace

int main(int argc, char** argv) {
    QApplication application(argc, argv);
    QApplication::setApplicationName(u"Tunestead"_s);
    QApplication::setApplicationVersion(QStringLiteral(TUNESTEAD_VERSION));
    QGuiApplication::setDesktopFileName(u"tunestead"_s);
    InstallGerman(application);
    const QStringList files = FilesOfCommandLine(application);

    ChooseIconTheme();
    QtDialogs dialogs;
    SetUserDialogs(&dialogs);
    int result = 0;
    {
        TTunesteadMainWnd window({LocateStandardFiles(), UserSettingsFile(), files});
        dialogs.SetMainWindow(&window);
        window.show();
        result = QApplication::exec();
    }
    SetUserDialogs(nullptr);
    return result;
}
