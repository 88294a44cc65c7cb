#pragma once

#include <QString>
#include <cstdio>

// A line of the terminal that is written over and over, and gone at the end.
class TransientLine {
 public:
    // nullptr: nobody watches. The caller keeps ownership.
    explicit TransientLine(std::FILE* terminal) : terminal_(terminal) {}
    ~TransientLine() { Erase(); }
    TransientLine(const TransientLine&) = delete;
    TransientLine& operator=(const TransientLine&) = delete;

    bool IsWatched() const { return terminal_ != nullptr; }
    // What does not fit is cut off.
    void Show(const QString& text);
    void Erase();

 private:
    void Print(const QString& text);

    std::FILE* terminal_;
    qsizetype shown_ = 0;  // characters that stand in the line
};
