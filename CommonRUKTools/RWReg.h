#pragma once

#include <QByteArray>
#include <QString>
#include <memory>
#include <optional>

class QSettings;

// The settings of the program: named values under a hierarchical key, each of which keeps its type (integer,
// boolean, string, binary). They lie in a text file in the user's configuration folder; the file is only ever
// replaced whole.
class TRWReg {
 public:
    // `key` as "\Software\RUK\Tunestead3"; `file` is another place for the values, as tests and portable use
    // need it.
    explicit TRWReg(const QString& key, const QString& file = DefaultFile());
    // Writes what has changed.
    ~TRWReg();
    TRWReg(const TRWReg&) = delete;
    TRWReg& operator=(const TRWReg&) = delete;

    static QString DefaultFile();

    // Whether nothing is stored under the key, as before the first start.
    bool IsEmpty() const;
    bool Exists(const QString& name) const;
    // Nothing when the value is missing, of another type, or damaged.
    std::optional<int> ReadInteger(const QString& name) const;
    std::optional<bool> ReadBool(const QString& name) const;
    std::optional<QString> ReadString(const QString& name) const;
    std::optional<QByteArray> ReadBinary(const QString& name) const;

    // A value that is stored already is not written again.
    void WriteInteger(const QString& name, int value);
    void WriteBool(const QString& name, bool value);
    void WriteString(const QString& name, const QString& value);
    void WriteBinary(const QString& name, const QByteArray& value);
    void Delete(const QString& name);

    // Deletes NAME0, NAME1, ... from `first` on, up to the first that does not exist.
    void DeleteNumbered(const QString& name, int first);

    // Writes what has changed now. Throws EStreamError when the file cannot be written.
    void Flush();

 private:
    std::optional<QString> Read(const QString& type, const QString& name) const;
    void Write(const QString& type, const QString& name, const QString& value);

    std::unique_ptr<QSettings> settings_;
};
