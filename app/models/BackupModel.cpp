#include "app/models/BackupModel.h"

#include <algorithm>

#include "ReadMPEGHeader/DisplayTexts.h"

using namespace Qt::StringLiterals;

using Kind = BackupDecision::Kind;

BackupModel::BackupModel(const TMusicDatabase& database, const std::vector<BackupFile>& files,
                         const std::vector<BackupCandidates>& candidates, QObject* parent)
    : QAbstractTableModel(parent),
      database_(database),
      files_(files),
      candidates_(candidates),
      decisions_(ProposeDecisions(candidates)) {}

int BackupModel::CountOf(Kind kind) const {
    return static_cast<int>(std::ranges::count(decisions_, kind, &BackupDecision::What));
}

int BackupModel::TiedCandidate(int row) const {
    const BackupDecision& decision = decisions_[At(row)];
    if (decision.What != Kind::Tie) return -1;
    const BackupCandidates& all = CandidatesOf(row);
    return static_cast<int>(std::ranges::find(all, decision.Song, &BackupCandidate::Song) - all.begin());
}

bool BackupModel::Tie(int row, std::size_t candidate) {
    if (candidate >= CandidatesOf(row).size()) return false;
    const BackupDecision tie{.What = Kind::Tie, .Song = CandidatesOf(row)[candidate].Song};
    if (const auto other = std::ranges::find(decisions_, tie); other != decisions_.end()) {
        *other = {};
        Changed(static_cast<int>(other - decisions_.begin()));
    }
    decisions_[At(row)] = tie;
    Changed(row);
    return true;
}

void BackupModel::Decide(int row, Kind kind) {
    decisions_[At(row)] = {.What = kind};
    Changed(row);
}

void BackupModel::Changed(int row) {
    Q_EMIT dataChanged(index(row, 0), index(row, ColumnCount - 1));
}

int BackupModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(files_.size());
}

int BackupModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : ColumnCount;
}

QVariant BackupModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation != Qt::Horizontal || role != Qt::DisplayRole) return {};
    static const QStringList captions = {u"Datei auf dem Datenträger"_s, u"Song der Sammlung"_s,
                                         u"Eigene Datei"_s, u"Entscheidung"_s};
    return captions[section];
}

const BackupCandidate* BackupModel::ShownCandidate(int row) const {
    const BackupCandidates& all = CandidatesOf(row);
    return all.empty() ? nullptr : &all[At(std::max(TiedCandidate(row), 0))];
}

QString BackupModel::CandidateCell(int row) const {
    const BackupCandidate* candidate = ShownCandidate(row);
    const TID3Tag* song = candidate != nullptr ? database_.Songs().Find(candidate->Song) : nullptr;
    return song != nullptr ? CandidateText(*candidate, *song) : QString();
}

QString BackupModel::OwnFileCell(int row) const {
    const BackupCandidate* candidate = ShownCandidate(row);
    const TID3Tag* song = candidate != nullptr ? database_.Songs().Find(candidate->Song) : nullptr;
    if (song == nullptr) return {};
    if (IsCdPath(song->FileName)) return u"auf "_s + database_.CDNameOf(song->FileName);
    return candidate->HasOwnFile ? u"vorhanden"_s : u"fehlt"_s;
}

QString BackupModel::DecisionCell(int row) const {
    switch (decisions_[At(row)].What) {
        case Kind::Tie:
            return u"Verknüpfen"_s;
        case Kind::TakeIn:
            return u"Neu aufnehmen"_s;
        default:
            return u"Überspringen"_s;
    }
}

QVariant BackupModel::data(const QModelIndex& index, int role) const {
    const BackupFile& file = files_[At(index.row())];
    if (role == Qt::ToolTipRole && index.column() == File) return file.Path;
    if (role != Qt::DisplayRole && role != Qt::ToolTipRole) return {};
    switch (index.column()) {
        case File:
            return ArtistAndTitle(file.Tag);
        case Candidate:
            return CandidateCell(index.row());
        case OwnFile:
            return OwnFileCell(index.row());
        default:
            return DecisionCell(index.row());
    }
}
