#include "MusicManagment/conversion/ConversionRun.h"

#include <QSet>
#include <QThread>
#include <atomic>

#include "CommonRUKTools/WorkAhead.h"
#include "MusicManagment/conversion/PartialFile.h"

namespace {

class Run {
 public:
    Run(const std::vector<ConversionJob>& jobs, const EncoderSettings& settings)
        : jobs_(jobs), settings_(settings), parts_(jobs.size()) {}

    // In one of several threads.
    ConversionOutcome Convert(std::size_t number) {
        if (stop_) return {};
        try {
            const auto goOn = [this, &part = parts_[number]](double done) {
                part = done;
                return !stop_.load();
            };
            ConversionOutcome outcome{.Record = ConvertSong(jobs_[number], settings_, goOn)};
            outcome.Done = true;
            parts_[number] = 1;
            return outcome;
        } catch (const EAbort&) {
            return {};
        } catch (const ERukException& error) {
            parts_[number] = 1;
            return {.Error = error.Message()};
        } catch (const std::bad_alloc&) {
            return {.Error = QStringLiteral("Der Speicher reicht nicht aus.")};
        }
    }

    ConversionState StateAt(std::size_t song) const {
        double sum = 0;
        for (const std::atomic<double>& part : parts_)
            sum += part;
        return {.Song = song, .SongPart = parts_[song], .Part = sum / static_cast<double>(parts_.size())};
    }
    void Stop() { stop_ = true; }

 private:
    const std::vector<ConversionJob>& jobs_;
    const EncoderSettings& settings_;
    std::vector<std::atomic<double>> parts_;
    std::atomic<bool> stop_ = false;
};

void SweepFolders(const std::vector<ConversionJob>& jobs) {
    QSet<QString> folders;
    for (const ConversionJob& job : jobs)
        folders.insert(FolderOfFile(job.Target));
    for (const QString& folder : folders)
        SweepPartialFiles(folder);
}

}  // namespace

std::vector<ConversionOutcome> RunConversions(const std::vector<ConversionJob>& jobs,
                                              const EncoderSettings& settings,
                                              const std::function<bool(const ConversionState&)>& goOn) {
    SweepFolders(jobs);
    Run run(jobs, settings);
    std::vector<ConversionOutcome> outcomes(jobs.size());
    // Stopping and an exception of `goOn` both must not wait for what is being made.
    WorkAhead<ConversionOutcome> work(jobs.size(), std::max(1, QThread::idealThreadCount()),
                                      [&run](std::size_t number, auto) -> std::function<ConversionOutcome()> {
                                          return [&run, number] { return run.Convert(number); };
                                      });
    struct Stopper {
        Run& Running;
        ~Stopper() { Running.Stop(); }
    } const stopper{run};
    for (std::size_t i = 0; i < jobs.size(); ++i) {
        work.Next();
        auto outcome = work.Take([&] { return goOn(run.StateAt(i)); });
        if (!outcome) {
            run.Stop();
            // What had come to its end nevertheless is there and counts.
            outcome = work.Take([] { return true; });
        }
        outcomes[i] = std::move(*outcome);
    }
    return outcomes;
}
