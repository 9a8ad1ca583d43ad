#pragma once

#include <string>
#include <string_view>
#include <utility>

#include "components/support/streamText.h"

namespace Ov {

/// What a stream keeps for itself.
struct RnStream::State {
    State(RnStream& stream, RnBufferedIO& device, Form form_, RnPostLoadList* postLoad_)
        : input(device), form(form_), postLoad(postLoad_), _stream(stream) {}

    /// The characters of the device. A separator that is due is skipped first.
    RnCharInput& chars() {
        if (std::exchange(_stream.pendingSeparator, false)) input.device().skipSeparator(1);
        return input;
    }
    /// Writes bytes as they are, a character each and all at once. Raises ExWriteError where the device does not take
    /// all of them.
    void writeBytes(std::string_view bytes);

    RnCharInput input;
    Form form;
    RnPostLoadList* postLoad;
    int depth = 0;      // objects being read or written in one another
    std::wstring text;  // what goes to the device as characters, kept for its memory

private:
    RnStream& _stream;
};

}  // namespace Ov
