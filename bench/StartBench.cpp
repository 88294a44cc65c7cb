// start_bench [SONGS]: from the start of the program's process to the list that shows all songs of its
// standard database, and the memory that it then holds. Every run is a process of its own, as it is for the
// user.

#include <QApplication>
#include <QElapsedTimer>
#include <QFile>
#include <QProcess>
#include <QTableView>
#include <QTemporaryDir>
#include <algorithm>
#include <cstdio>
#include <vector>

#include "app/MainWindow.h"
#include "app/desktop/Icons.h"
#include "app/desktop/Translations.h"
#include "bench/FakeSongs.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kRuns = 5;
constexpr int kWaitLimit = 60'000;  // milliseconds

// Without it paths of songs that are not there would be looked for on the disk.
constexpr AddAs kAsItIs = AddAs::Loaded;

void SaveCollection(const StandardFiles& files, int songs) {
    TMusicDatabase database;
    database.BeginLoading();
    for (const TID3Tag& song : MakeFakeSongs(songs))
        database.AddEntry(QString(), song, kAsItIs);
    database.EndLoading();
    database.SaveDatabase(files.Database());
}

qint64 ResidentKilobytes() {
    QFile status(u"/proc/self/status"_s);
    if (!status.open(QIODevice::ReadOnly)) return -1;
    for (const QByteArray& line : status.readAll().split('\n'))
        if (line.startsWith("VmRSS:")) return line.mid(6).simplified().split(' ').first().toLongLong();
    return -1;
}

// The program as its main function starts it; ends as soon as the list is filled and painted.
int ShowCollection(int argc, char** argv, const QString& folder, int songs) {
    QElapsedTimer clock;
    clock.start();
    QApplication application(argc, argv);
    InstallGerman(application);
    ChooseIconTheme();
    TTunesteadMainWnd window({{folder}, folder + u"/settings.ini"_s, {}});
    window.show();
    const auto* list = window.findChild<QTableView*>();
    while (list->model()->rowCount() < songs && clock.elapsed() < kWaitLimit)
        QApplication::processEvents(QEventLoop::AllEvents, 5);
    QApplication::processEvents();
    std::printf("%lld %lld\n", static_cast<long long>(clock.elapsed()),
                static_cast<long long>(ResidentKilobytes()));
    return list->model()->rowCount() == songs ? 0 : 1;
}

bool Measure(const QString& folder, int songs) {
    std::vector<qint64> starts;
    std::vector<qint64> own;
    qint64 memory = 0;
    for (int run = 0; run < kRuns; ++run) {
        QElapsedTimer clock;
        clock.start();
        QProcess program;
        program.start(QCoreApplication::applicationFilePath(), {u"--show"_s, folder, QString::number(songs)});
        if (!program.waitForFinished(kWaitLimit) || program.exitCode() != 0) return false;
        starts.push_back(clock.elapsed());
        const QList<QByteArray> figures = program.readAllStandardOutput().simplified().split(' ');
        own.push_back(figures.value(0).toLongLong());
        memory = std::max(memory, figures.value(1).toLongLong());
    }
    std::ranges::sort(starts);
    std::ranges::sort(own);
    std::printf(
        "%d songs: list filled after %lld ms (process from start to end %lld ms), %lld MiB resident\n", songs,
        static_cast<long long>(own[kRuns / 2]), static_cast<long long>(starts[kRuns / 2]),
        static_cast<long long>(memory / 1024));
    return true;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc == 4 && QByteArrayView(argv[1]) == "--show")
        return ShowCollection(argc, argv, QString::fromLocal8Bit(argv[2]), QByteArray(argv[3]).toInt());
    const QCoreApplication application(argc, argv);
    const int songs = argc > 1 ? QByteArray(argv[1]).toInt() : 100'000;
    const QTemporaryDir folder;
    if (songs <= 0 || !folder.isValid()) return 2;
    SaveCollection({folder.path()}, songs);
    return Measure(folder.path(), songs) ? 0 : 1;
}
