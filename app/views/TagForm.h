#pragma once

#include <QDockWidget>
#include <QTimer>
#include <functional>
#include <vector>

#include "CommonRUKTools/Listeners.h"
#include "app/models/TagEdits.h"
#include "app/models/TagPreview.h"

class CoverEdit;
class ElidedLabel;
class QAbstractButton;
class QLabel;
class QPushButton;
class QTabWidget;
class TagFields;
class TagPreviewList;

using FieldTexts = std::vector<std::pair<SongFieldId, QString>>;

// What might stand in a song's tag.
struct TagProposal {
    FieldTexts Fields{};
    std::optional<CoverPicture> Cover{};
};

// The tool window that edits the tags of the focused or the marked songs. What was edited stays, whatever the
// list shows meanwhile, until it is applied or the user gives it up.
class TID3TagForm : public QDockWidget {
 public:
    explicit TID3TagForm(TMusicDatabase& database, QWidget* parent = nullptr);

    static constexpr std::size_t kMostSongs = 65'536;

    enum class ChosenBy { User, Program };
    // Shows these songs, in the order of the list. With edits that are not applied it keeps its songs; where
    // the user has chosen others it asks, a moment later.
    void ShowSongs(const std::vector<SongHandle>& songs, ChosenBy by);
    // The first of its songs, or with a positive `end` the last; none when it has none.
    SongHandle EditedSong(int end) const;
    // Comes to the front and lets the user type.
    void Edit();
    // The one song that a proposal would be for; throws ERukException, for the user, unless there is one.
    SongHandle SongToProposeTo() const;
    // Brings suggestions from elsewhere as edits that are not applied, and comes to the front. May ask about
    // edits of other songs; EAbort where these stay.
    void Propose(const TagProposal& proposal);
    // Asks about edits that are not applied. False when they are to stay; never two questions at once.
    bool MayLeave();

    // The commands of its buttons. Apply is false when something is left to do; throws what UpdateSongs
    // throws.
    bool Apply();
    void Discard();

    // Wants the next (1) or the previous (-1) song of the list to be chosen.
    std::function<void(int step)> OnStep;
    // Asks which songs are chosen in the list, in its order.
    std::function<std::vector<SongHandle>()> OnAskOrder;
    // Wants its songs to be marked in the list again; returns the songs that are chosen then.
    std::function<std::vector<SongHandle>(const std::vector<SongHandle>&)> OnReturn;
    // Told what came of a command, in a sentence for the status bar.
    std::function<void(const QString&)> OnDone;

 protected:
    void closeEvent(QCloseEvent* event) override;
    void showEvent(QShowEvent* event) override;

 private:
    QWidget* MakeHead();
    QWidget* MakeButtons();
    QAbstractButton* MakeStep(int step);
    void SetUpKeys();
    void FollowDatabase();

    void Take(const std::vector<SongHandle>& songs);
    void TakeProposed(const FieldTexts& fields);
    void AskToLeave();
    void ReadFiles();
    void RecordsChanged();
    void LookAgain();
    void Number();
    void Edited();
    void ShowAll();
    void ShowHead();
    void ShowState();
    void ShowPreview();
    bool IsEditable() const;
    BatchResult Update();

    TMusicDatabase& database_;
    TagEdits edits_;
    FileTagsReader reader_;
    ElidedLabel* head_;
    QAbstractButton* previous_;
    QAbstractButton* next_;
    QTabWidget* tabs_;
    TagFields* fields_;
    CoverEdit* cover_;
    TagPreviewList* preview_;
    QLabel* summary_;
    QPushButton* apply_;
    QPushButton* discard_;
    std::vector<SongHandle> chosen_;  // in the list, which may be other songs than those edited
    std::vector<SongHandle> kept_;    // chosen when the user decided to go on editing
    FieldTexts proposed_;             // the last one for these songs
    bool stale_ = false;              // other songs were chosen while it could not be seen
    bool tooMany_ = false;
    bool asking_ = false;
    bool applying_ = false;
    QTimer askTimer_;
    QTimer readTimer_;
    QTimer lookTimer_;
    QTimer previewTimer_;
    Subscriptions subscriptions_;
};
