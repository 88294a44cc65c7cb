#pragma once

#include "CommonRUKTools/DialogsInFront.h"

// For its lifetime messages to the user are lines for a place that needs no answer: nobody may sit in front
// of a program that another one drives, and that one waits. Questions are asked as ever.
class LineDialogs : public DialogsInFront {
 public:
    explicit LineDialogs(const std::function<void(const QString&)>& tell) : tell_(tell) {}

    void ShowMessage(MessageKind, const QString& text) override { tell_(text); }

 private:
    const std::function<void(const QString&)>& tell_;
};
