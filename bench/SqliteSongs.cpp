#include "bench/SqliteSongs.h"

#include <sqlite3.h>

#include <memory>
#include <stdexcept>

namespace {

struct Close {
    void operator()(sqlite3* database) const { sqlite3_close(database); }
    void operator()(sqlite3_stmt* statement) const { sqlite3_finalize(statement); }
};
using Connection = std::unique_ptr<sqlite3, Close>;
using Statement = std::unique_ptr<sqlite3_stmt, Close>;

Connection Open(const QString& path) {
    sqlite3* database = nullptr;
    const int result = sqlite3_open(path.toUtf8().constData(), &database);
    Connection connection(database);
    if (result != SQLITE_OK) throw std::runtime_error(sqlite3_errmsg(database));
    return connection;
}

void Execute(const Connection& connection, const char* sql) {
    if (sqlite3_exec(connection.get(), sql, nullptr, nullptr, nullptr) != SQLITE_OK)
        throw std::runtime_error(sqlite3_errmsg(connection.get()));
}

Statement Prepare(const Connection& connection, const char* sql) {
    sqlite3_stmt* statement = nullptr;
    if (sqlite3_prepare_v2(connection.get(), sql, -1, &statement, nullptr) != SQLITE_OK)
        throw std::runtime_error(sqlite3_errmsg(connection.get()));
    return Statement(statement);
}

// Binds or reads the columns of one row in their order.
class Binder {
 public:
    explicit Binder(sqlite3_stmt* statement) : statement_(statement) {}
    void Text(const QString& text) {
        const QByteArray bytes = text.toUtf8();
        sqlite3_bind_text(statement_, ++column_, bytes.constData(), static_cast<int>(bytes.size()),
                          SQLITE_TRANSIENT);
    }
    void Number(qint64 value) { sqlite3_bind_int64(statement_, ++column_, value); }
    void Real(double value) { sqlite3_bind_double(statement_, ++column_, value); }

 private:
    sqlite3_stmt* statement_;
    int column_ = 0;
};

class Columns {
 public:
    explicit Columns(sqlite3_stmt* statement) : statement_(statement) {}
    void Text(QString& text) {
        const auto* bytes = reinterpret_cast<const char*>(sqlite3_column_text(statement_, column_));
        text = QString::fromUtf8(bytes, sqlite3_column_bytes(statement_, column_));
        ++column_;
    }
    template <typename T>
    void Number(T& value) {
        value = static_cast<T>(sqlite3_column_int64(statement_, column_++));
    }
    void Real(double& value) { value = sqlite3_column_double(statement_, column_++); }

 private:
    sqlite3_stmt* statement_;
    int column_ = 0;
};

template <typename Row, typename Song>
void ForEachField(Row& row, Song& song) {
    row.Text(song.FileName);
    row.Text(song.Title);
    row.Text(song.Artist);
    row.Text(song.Album);
    row.Text(song.Year);
    row.Text(song.Comment);
    row.Text(song.MPEGLayer);
    row.Number(song.Length);
    row.Number(song.Genre);
    row.Number(song.BitRate);
    row.Number(song.SampleRate);
    row.Number(song.ChannelMode);
    row.Number(song.Emphasis);
    row.Number(song.Private);
    row.Number(song.Protected);
    row.Number(song.Copyrighted);
    row.Number(song.Original);
    row.Number(song.Padding);
    row.Number(song.FrameSize);
    row.Number(song.Track);
    row.Number(song.PlayCount);
    row.Number(song.Reserved);
    row.Number(song.Flags);
    row.Number(song.MainGenre);
    row.Number(song.Remix);
    row.Real(song.AddTime);
}

}  // namespace

void WriteSqliteSongs(const QString& path, const SongList& songs) {
    const Connection connection = Open(path);
    Execute(
        connection,
        "CREATE TABLE songs(path TEXT, title TEXT, artist TEXT, album TEXT, year TEXT, comment TEXT, "
        "format TEXT, length INT, genre INT, bitrate INT, samplerate INT, channels INT, emphasis INT, "
        "private INT, protected INT, copyrighted INT, original INT, padding INT, framesize INT, track INT, "
        "playcount INT, reserved INT, flags INT, maingenre INT, remix INT, addtime REAL); BEGIN");
    const Statement insert =
        Prepare(connection, "INSERT INTO songs VALUES(?,?,?,?,?,?,?,?,?,?,?,?,?,?,?,?,?,?,?,?,?,?,?,?,?,?)");
    for (const auto& song : songs) {
        Binder row(insert.get());
        ForEachField(row, *song);
        if (sqlite3_step(insert.get()) != SQLITE_DONE) throw std::runtime_error("insert failed");
        sqlite3_reset(insert.get());
    }
    Execute(connection, "COMMIT");
}

std::vector<TID3Tag> ReadSqliteSongs(const QString& path) {
    const Connection connection = Open(path);
    const Statement select = Prepare(connection, "SELECT * FROM songs");
    std::vector<TID3Tag> songs;
    while (sqlite3_step(select.get()) == SQLITE_ROW) {
        Columns row(select.get());
        ForEachField(row, songs.emplace_back());
    }
    return songs;
}
