#pragma once

#include <QLocalServer>
#include <QLockFile>
#include <QStringList>
#include <chrono>
#include <functional>

// What a start of the program was given.
struct StartRequest {
    QStringList Arguments;    // without the program's name; paths are absolute
    QString ActivationToken;  // the desktop's permission to take the focus; may be empty
};

// Lets one program at a time work on a folder of standard files: two would overwrite each other's database.
// A later start hands what it was given to the first one.
class SingleInstance {
 public:
    enum class Role {
        First,       // this program works on the folder
        HandedOver,  // the first one has taken the request; this program is to end
        Unanswered   // the first one does not answer; this program must not go on
    };

    // `dataFolder` holds the standard files; it is made when it is missing. `socketFolder` is one that only
    // this user may enter.
    explicit SingleInstance(const QString& dataFolder, const QString& socketFolder = RuntimeFolder());
    SingleInstance(const SingleInstance&) = delete;
    SingleInstance& operator=(const SingleInstance&) = delete;

    // Told of each later start, from the event loop. It must return soon and open no dialog, for the other
    // program waits. False when this one is about to end, so that the other may take its place.
    std::function<bool(const StartRequest&)> OnStart;

    // Lets events happen while it waits for the first program, for `patience` at most.
    Role Start(const StartRequest& request, std::chrono::milliseconds patience = std::chrono::seconds(2));

    // Who works on the folder, for a message: "Prozess 4711", with the computer where it is another one.
    QString Holder() const;

 private:
    enum class Answer { Taken, Refused, None };

    static QString RuntimeFolder();
    bool TakeFolder();
    void Listen();
    Answer HandOver(const StartRequest& request, std::chrono::milliseconds patience) const;
    void Serve(QLocalSocket& socket);
    void Receive(QLocalSocket& socket);

    QString folder_;
    QString socketName_;
    QLockFile lock_;
    QLocalServer server_;
};
