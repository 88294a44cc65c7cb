#pragma once

#include <QSet>
#include <functional>
#include <memory>
#include <vector>

#include "MusicManagment/database/journal/JournalFile.h"
#include "MusicManagment/database/journal/StepWork.h"

// Planned steps that belong together: the first that fails ends them.
struct PlannedItem {
    std::vector<PlannedStep> Steps{};
    QString Message{};  // why there are no more steps, when one could not be planned
    // How many steps were done, and why the next was not.
    std::function<void(std::size_t done, const QString& message)> Done{};
};

// Carries out items in groups: announces what brings them back, waits for the journal, changes the files,
// waits for these, and writes down what came of it. When that cannot be written the group is taken back.
class BatchRun {
 public:
    // Without a journal nothing is written down.
    BatchRun(std::unique_ptr<JournalFile> journal, BatchHeader header);

    // Whether one of these paths belongs to an item that waits.
    bool Touches(const PlannedItem& item) const;
    bool Touches(const QString& path) const { return touched_.contains(path); }
    // Carries the group out when it is full.
    void Add(PlannedItem item);
    void Settle();
    void Finish(const QString& caption, bool dropsRest);
    bool HasBegun() const { return hasBegun_; }

 private:
    struct Work;
    void CarryOut(std::vector<PlannedItem>& group);
    void Announce(const std::vector<PlannedItem>& group);
    void WriteOutcomes(const std::vector<Work>& works);

    std::unique_ptr<JournalFile> journal_;
    BatchHeader header_;
    std::vector<PlannedItem> waiting_;
    QSet<QString> touched_;
    qint64 waitingBytes_ = 0;
    std::size_t waitingSteps_ = 0;
    std::size_t waitingFiles_ = 0;
    quint32 items_ = 0;
    quint32 steps_ = 0;  // that were announced
    bool hasBegun_ = false;
    QString broken_;  // why nothing more can be done
};
