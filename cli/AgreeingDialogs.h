#pragma once

#include "CommonRUKTools/DialogsInFront.h"

// Answers every question of two buttons with the first, which agrees. Where there is a choice, agreeing means
// nothing.
class AgreeingDialogs : public DialogsInFront {
 public:
    int Ask(const Question& question) override {
        return question.Buttons.size() == 2 ? 0 : DialogsInFront::Ask(question);
    }
};
