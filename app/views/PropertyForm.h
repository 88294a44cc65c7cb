#pragma once

#include <QDockWidget>
#include <QTimer>
#include <optional>

#include "app/models/FileDetails.h"

class CoverView;
class PropertyTree;
class TMusicDatabase;

// The tool window that shows everything known of the focused song. The song's file is read only while the
// window can be seen, and a moment after the last change, so that going through the list stays fast.
class TPropertyForm : public QDockWidget {
 public:
    explicit TPropertyForm(const TMusicDatabase& database, QWidget* parent = nullptr);

    // Shows a song, or nothing; the song is copied.
    void ShowSong(const TID3Tag* song);
    // Looks at the file again, which may have changed.
    void Reload();
    // Reads the file now instead of a moment later.
    void ReadFile();
    bool ReadPending() const { return readTimer_.isActive(); }

    PropertyTree& Properties() { return *tree_; }

 protected:
    void showEvent(QShowEvent* event) override;
    void hideEvent(QHideEvent* event) override;

 private:
    void Refresh();
    void ShowRows();
    std::vector<PropertyGroup> Groups() const;
    std::vector<PropertyRow> FrameRows() const;

    const TMusicDatabase& database_;
    PropertyTree* tree_;
    CoverView* cover_;
    std::optional<TID3Tag> song_;
    std::optional<FileDetails> details_;  // of the song's file, once it has been read
    bool stale_ = false;                  // something changed while the window was hidden
    QTimer readTimer_;
};
