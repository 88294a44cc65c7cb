#pragma once

#include <QString>
#include <cstdint>
#include <memory>
#include <optional>
#include <tuple>

enum class EntryKind {
    File,
    Folder,
    Other,  // a pipe, socket or device, or a link that leads nowhere
};

struct FolderEntry {
    QString Name;
    EntryKind Kind = EntryKind::Other;
    // False when the name is no valid text: no path can be made of it, and Name only shows it, with each bad
    // byte as "\xE4".
    bool Reachable = true;
    bool IsSystem = false;  // hidden by the system from its users; only some systems know that of a folder
};

// What tells a folder from every other folder of the machine, by whatever path it was reached.
struct FolderIdentity {
    std::uint64_t Volume = 0;
    std::uint64_t Number = 0;

    bool operator==(const FolderIdentity&) const = default;
    // Any order; for sets.
    bool operator<(const FolderIdentity& other) const {
        return std::tie(Volume, Number) < std::tie(other.Volume, other.Number);
    }
};

// Nothing when there is no such folder.
std::optional<FolderIdentity> IdentifyFolder(const QString& folder);

// The entries of one folder, one by one and in no order, without "." and "..". A symbolic link counts as what
// it leads to.
class FolderEntries {
 public:
    // Throws EStreamError when the folder cannot be opened.
    explicit FolderEntries(const QString& folder);
    ~FolderEntries();

    FolderIdentity Identity() const;
    // False at the end. Throws EStreamError when the folder cannot be read any further.
    bool Next(FolderEntry& entry);

 private:
    struct Handle;
    std::unique_ptr<Handle> handle_;
    QString folder_;
};
