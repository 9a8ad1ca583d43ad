#pragma once

#include <new>

#include "components/messageFile/messageIds.h"
#include "components/photo/lid/reportMessage.h"

namespace OvPhotometrics {

/// Does `work`, which answers a bool; false after message 12936 where memory runs out.
template <class Work>
bool withinMemory(Work&& work) {
    try {
        return work();
    } catch (const std::bad_alloc&) {
        reportMessage(messages::outOfMemory);
        return false;
    }
}

/// Does `install`, which answers whether a web took the record that it filled; false after message 12935, or 12936
/// where memory runs out.
template <class Install>
bool installOrReport(Install&& install) {
    return withinMemory([&] {
        if (install()) return true;
        reportMessage(messages::webRefused);
        return false;
    });
}

}  // namespace OvPhotometrics
