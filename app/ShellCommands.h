#pragma once

// Numbers of the commands that the program adds to the database's menu; the database's own are below 1000.
enum ShellCommandId : int {
    scExit = 9001,
    scOptions = 9002,
    scWizard = 9003,
    scUndo = 9004,
    scRedo = 9005,
    scEditTags = 9006,
};
