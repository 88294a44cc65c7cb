#include <algorithm>
#include <map>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/journal/BatchRun.h"
#include "MusicManagment/database/journal/Journal.h"
#include "MusicManagment/database/journal/JournalLists.h"

using namespace Qt::StringLiterals;

namespace {

// A step that is to be taken back, with its number in its batch.
struct Standing {
    quint32 Number;
    JournalStep Step;
};
using StandingItem = std::vector<Standing>;

// Where the file of a patch is, once the item's later moves have taken it along.
QString PlaceNow(const StandingItem& item, std::size_t patch) {
    QString path = item[patch].Step.Path;
    for (std::size_t i = patch + 1; i < item.size(); ++i)
        if (item[i].Step.Kind == StepKind::Move && item[i].Step.Path == path) path = item[i].Step.To;
    return path;
}

// Backwards; but a file has its old version first and then its old place, because versions are written for
// the whole group before anything moves.
std::vector<std::size_t> BackOrder(const StandingItem& item) {
    std::vector<std::size_t> order;
    for (std::size_t i = item.size(); i-- > 0;)
        order.push_back(i);
    std::stable_partition(order.begin(), order.end(),
                          [&item](std::size_t i) { return item[i].Step.Kind == StepKind::Patch; });
    return order;
}

PlannedItem PlanBack(const StandingItem& item) {
    PlannedItem planned;
    for (const std::size_t i : BackOrder(item)) {
        PlannedStep step = PlanBackStep(item[i].Step, PlaceNow(item, i));
        if (step.Step.Kind == StepKind::Move && !planned.Steps.empty() &&
            planned.Steps.front().Step.Kind == StepKind::Patch)
            step.Step.Before = planned.Steps.front().Step.After;
        step.Step.Takes = static_cast<qint32>(item[i].Number);
        planned.Steps.push_back(std::move(step));
    }
    return planned;
}

// Takes back what stands of one batch, as a batch of its own.
class TakingBack {
 public:
    TakingBack(std::unique_ptr<JournalFile> file, BatchKind kind, const RestOfBatch& rest,
               TMusicDatabase* database)
        : source_(*file), rest_(rest), database_(database), run_(std::move(file), HeaderFor(kind, rest)) {}

    UndoResult Run() {
        result_.Caption = rest_.Batch->Header.Caption;
        std::size_t end = rest_.Steps.size();
        while (end > 0) {
            std::size_t begin = end - 1;
            const auto itemOf = [this](std::size_t i) {
                return rest_.Batch->Steps[rest_.Steps[i]].Head.Item;
            };
            while (begin > 0 && itemOf(begin - 1) == itemOf(end - 1))
                --begin;
            TakeItem(begin, end);
            end = begin;
        }
        run_.Settle();
        Apply();
        // What could not be done now may be tried again, unless nothing of it can be.
        run_.Finish({}, failedNow_ == 0 || result_.Items == 0);
        return std::move(result_);
    }

 private:
    static BatchHeader HeaderFor(BatchKind kind, const RestOfBatch& rest) {
        BatchHeader header = rest.Batch->Header;
        header.Kind = kind;
        header.Of = header.Id;
        header.Time = FromDayCount(CurrentClock().Now()).toMSecsSinceEpoch();
        return header;
    }

    void TakeItem(std::size_t begin, std::size_t end) {
        StandingItem item;
        for (std::size_t i = begin; i < end; ++i) {
            const quint32 number = rest_.Steps[i];
            auto step = source_.Load(rest_.Batch->Steps[number]);
            if (!step) {
                result_.Problems
                    << u"Das Journal ist beschädigt; ein Schritt kann nicht zurückgenommen werden."_s;
                return;
            }
            item.push_back({number, std::move(*step)});
        }
        try {
            PlannedItem planned = PlanAlone(item);
            planned.Done = [this, steps = planned.Steps.size(), records = RecordsOf(planned)](
                               std::size_t done, const QString& message) {
                Note(steps, records, done, message);
            };
            Carry(std::move(planned));
        } catch (const EFileChanged& error) {
            result_.Problems << error.Message();
        } catch (const EStreamError& error) {
            result_.Problems << error.Message();
            ++failedNow_;
        }
    }

    // Whoever holds a file that leaves its place lets go of it, and does not wait for the other items.
    void Carry(PlannedItem planned) {
        for (const PlannedStep& each : planned.Steps) {
            const JournalStep& step = each.Step;
            const auto takeUp = Release(step);
            if (!takeUp) continue;
            const QString from = step.Path;
            const QString to = step.Kind == StepKind::Move ? step.To : from;
            run_.Settle();
            const int before = result_.Items;
            run_.Add(std::move(planned));
            run_.Settle();
            return takeUp(result_.Items > before ? to : from);
        }
        run_.Add(std::move(planned));
    }

    std::function<void(const QString& path)> Release(const JournalStep& step) const {
        const bool leaves = step.Kind == StepKind::Move || step.Kind == StepKind::Trash;
        if (!leaves || database_ == nullptr || !database_->OnReleaseFile) return nullptr;
        return database_->OnReleaseFile(step.Path);
    }

    // Files that belong to a waiting item are looked at when that is done.
    PlannedItem PlanAlone(const StandingItem& item) {
        for (const Standing& standing : item)
            if (run_.Touches(standing.Step.Path) || run_.Touches(standing.Step.To)) {
                run_.Settle();
                break;
            }
        PlannedItem planned = PlanBack(item);
        if (!run_.Touches(planned)) return planned;
        run_.Settle();
        return PlanBack(item);
    }

    struct Changes {
        std::vector<std::pair<std::size_t, RecordChange>> Records{};  // each with the number of its step
        std::vector<std::pair<std::size_t, BanChange>> Bans{};
    };
    static Changes RecordsOf(const PlannedItem& item) {
        Changes changes;
        for (std::size_t i = 0; i < item.Steps.size(); ++i) {
            const JournalStep& step = item.Steps[i].Step;
            if (step.Kind == StepKind::Record) changes.Records.emplace_back(i, step.Record);
            if (step.Kind == StepKind::Ban) changes.Bans.emplace_back(i, step.Ban);
        }
        return changes;
    }

    void Note(std::size_t steps, const Changes& changes, std::size_t done, const QString& message) {
        for (const auto& [number, record] : changes.Records)
            if (number < done) records_.push_back(record);
        for (const auto& [number, ban] : changes.Bans)
            if (number < done) bans_.push_back(ban);
        if (done == steps) {
            ++result_.Items;
            return;
        }
        result_.Problems << message;
        ++failedNow_;
    }

    void Apply() {
        if (database_ == nullptr) return;
        result_.Songs = ApplyRecords(*database_, records_).Songs;
        if (ApplyBans(*database_, bans_)) database_->Events().BannListChanged.Tell();
    }

    JournalFile& source_;
    const RestOfBatch& rest_;
    TMusicDatabase* database_;
    BatchRun run_;
    std::vector<RecordChange> records_;
    std::vector<BanChange> bans_;
    UndoResult result_;
    int failedNow_ = 0;
};

void RefuseOtherDatabase(const RestOfBatch& rest, const TMusicDatabase* database) {
    const bool isAboutSongs = std::ranges::any_of(
        rest.Steps, [&rest](quint32 step) { return !rest.Batch->Steps[step].Head.IsOfFile(); });
    if (!isAboutSongs) return;
    const QString& needed = rest.Batch->Header.Database;
    if (database == nullptr || !IsSameDatabase(*database, needed)) throw EOtherDatabase(needed);
    if (!database->TakesChanges())
        throw EMusicDatabaseException(u"Die Datenbank kann jetzt nicht geändert werden."_s);
}

// The last of a list is looked at again when the journal is in our hands.
UndoResult TakeBackLast(std::unique_ptr<JournalFile> file, BatchKind kind,
                        std::vector<RestOfBatch> JournalLists::*list, TMusicDatabase* database) {
    const JournalContents contents = file->Contents();
    const JournalLists lists = ListsOf(contents);
    if ((lists.*list).empty()) return {};
    const RestOfBatch& rest = (lists.*list).back();
    RefuseOtherDatabase(rest, database);
    return TakingBack(std::move(file), kind, rest, database).Run();
}

}  // namespace

UndoResult Journal::Undo(TMusicDatabase* database) {
    UndoResult result = TakeBackLast(Open(), BatchKind::Undo, &JournalLists::ToUndo, database);
    Changed.Tell();
    return result;
}

UndoResult Journal::Redo(TMusicDatabase* database) {
    UndoResult result = TakeBackLast(Open(), BatchKind::Redo, &JournalLists::ToRedo, database);
    Changed.Tell();
    return result;
}
