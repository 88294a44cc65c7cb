#include "app/desktop/CoverFile.h"

#include <QFile>
#include <QUrl>
#include <utility>

#include "app/models/CoverPictures.h"

using namespace Qt::StringLiterals;

CoverFile::CoverFile() {
    reader_.OnRead = [this](const FileTags& tags) {
        if (tags.Cover) Take(*tags.Cover);
    };
}

void CoverFile::Show(const QString& song) {
    if (song == song_) return;
    song_ = song;
    url_.clear();
    if (!path_.isEmpty()) QFile::remove(std::exchange(path_, {}));
    if (song.isEmpty())
        reader_.Stop();
    else
        reader_.Read({song});
}

// A picture that cannot be kept is none: the song plays without it.
void CoverFile::Take(const QByteArray& picture) {
    if (!folder_) folder_ = std::make_unique<QTemporaryDir>();
    path_ = folder_->filePath(u"cover%1.%2"_s.arg(++count_).arg(SuffixOfPicture(picture)));
    QFile file(path_);
    if (!file.open(QIODevice::WriteOnly) || file.write(picture) != picture.size()) return;
    file.close();
    url_ = QString::fromLatin1(QUrl::fromLocalFile(path_).toEncoded());
    if (OnFound) OnFound();
}
