#pragma once

#include "CommonRUKTools/Errors.h"

// The message of the exception of this kind that an action ends with; empty when it ends well.
template <typename Exception = ERukException, typename Action>
QString ErrorOf(Action action) {
    try {
        action();
    } catch (const Exception& error) {
        return error.Message();
    }
    return {};
}
