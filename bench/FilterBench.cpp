// What a key in the filter line costs with a collection of 100,000 songs.

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QItemSelectionModel>
#include <QSortFilterProxyModel>
#include <QTableView>

#include "app/models/FilteredSongs.h"
#include "app/views/SongListWidget.h"
#include "bench/FakeSongs.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kSongs = 100'000;

// The collection, and the list over it in a window that is shown.
struct Window {
    Window() {
        database.BeginLoading();
        for (const TID3Tag& song : MakeFakeSongs(kSongs))
            database.AddEntry(QString(), song, AddAs::Loaded);
        database.EndLoading();
        database.SetSortType(stTitle);
        songs.SyncViews();
        list.resize(1600, 900);
        list.show();
        QApplication::processEvents();
    }

    TMusicDatabase database;
    SongListModel songs{database};
    FilteredSongs shown{songs};
    SongListWidget list{shown, database};
};

Window& TheWindow() {
    static auto* window = new Window;  // goes with the process: widgets must not outlive the application
    return *window;
}

void TestSongs(benchmark::State& state, const QString& text) {
    const SongFilter filter = SongFilter::Parse(text);
    std::size_t found = 0;
    for (auto _ : state) {
        found = 0;
        for (const auto& song : TheWindow().database.Songs())
            found += filter.Matches(*song) ? 1 : 0;
    }
    state.counters["found"] = static_cast<double>(found);
}

// One text after the other in the line, with everything until the list is painted.
void Type(benchmark::State& state, const QString& from, const QString& to) {
    Window& window = TheWindow();
    for (auto _ : state) {
        state.PauseTiming();
        window.shown.SetText(from);
        QApplication::processEvents();
        state.ResumeTiming();
        window.shown.SetText(to);
        QApplication::processEvents();
    }
    state.counters["found"] = window.shown.rowCount();
    window.shown.SetText(QString());
}

// The peer: Qt's own filter model with the same test.
void TypeWithQtProxy(benchmark::State& state, const QString& from, const QString& to) {
    class Proxy : public QSortFilterProxyModel {
     public:
        SongFilter Filter;
        void Refilter() { invalidateFilter(); }

     protected:
        bool filterAcceptsRow(int row, const QModelIndex&) const override {
            return Filter.Matches(*TheWindow().songs.SongAt(row));
        }
    };
    Proxy proxy;
    proxy.setSourceModel(&TheWindow().songs);
    QTableView view;
    view.setModel(&proxy);
    view.resize(1600, 900);
    view.show();
    for (auto _ : state) {
        state.PauseTiming();
        proxy.Filter = SongFilter::Parse(from);
        proxy.Refilter();
        QApplication::processEvents();
        state.ResumeTiming();
        proxy.Filter = SongFilter::Parse(to);
        proxy.Refilter();
        QApplication::processEvents();
    }
    state.counters["found"] = proxy.rowCount();
}

void InvertScatteredMarks(benchmark::State& state) {
    Window& window = TheWindow();
    window.list.clearSelection();
    QItemSelection every;
    for (int row = 0; row < kSongs; row += static_cast<int>(state.range(0)))
        every.append(QItemSelectionRange(window.shown.index(row, 0), window.shown.index(row, 1)));
    window.list.selectionModel()->select(every, QItemSelectionModel::Select);
    for (auto _ : state) {
        window.list.InvertMarks();
        QApplication::processEvents();
    }
    window.list.clearSelection();
}

void MarkAll(benchmark::State& state) {
    for (auto _ : state) {
        TheWindow().list.MarkAll();
        benchmark::DoNotOptimize(TheWindow().list.MarkedSongs());
    }
    TheWindow().list.clearSelection();
}

void SearchALetterThatNoSongBeginsWith(benchmark::State& state) {
    for (auto _ : state)
        TheWindow().list.keyboardSearch(u"\u2603"_s);
}

BENCHMARK_CAPTURE(TestSongs, OneWord, u"wald"_s)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(TestSongs, NoHit, u"qqqq"_s)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(TestSongs, Year, u"jahr:1980..1989"_s)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(Type, FirstLetter, u""_s, u"w"_s)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(Type, FirstLetterRare, u""_s, u"q"_s)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(Type, NextLetter, u"w"_s, u"wa"_s)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(Type, Clear, u"wa"_s, u""_s)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(TypeWithQtProxy, FirstLetter, u""_s, u"w"_s)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(TypeWithQtProxy, Clear, u"wa"_s, u""_s)->Unit(benchmark::kMillisecond);
BENCHMARK(MarkAll)->Unit(benchmark::kMillisecond);
BENCHMARK(InvertScatteredMarks)->Arg(100)->Arg(10)->Arg(2)->Unit(benchmark::kMillisecond);
BENCHMARK(SearchALetterThatNoSongBeginsWith)->Unit(benchmark::kMillisecond);

}  // namespace

int main(int argc, char** argv) {
    QApplication application(argc, argv);
    TheWindow();
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
