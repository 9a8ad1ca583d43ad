#pragma once

#include <functional>
#include <string>
#include <vector>

#include "host/componentManager/castable.h"

namespace Ov {

/// The host's services to whoever runs in it: a place to report messages, and a finder of files.
///
/// Threads:  any number may call the host's own. One that stands in for it is called by all threads that read or report.
class OVHOST_API RnProcessController : public RnCastable {
public:
    /// Id of the interface.
    [[gnu::used]] static constexpr RnUid iid{0xeb719621, 0xc02011d1, 0xaa7a00c0, 0x4fb1532a};

    /// Shows a message to the user. Level 0 is an ordinary message. The host's own does so for one thread at a time:
    /// another waits until the reporter is done. The reporter may call back into the library: what that reports comes
    /// to it at once, inside its call. It must not wait for other threads that may report. What it throws is passed on.
    virtual void report(int level, const wchar_t* text) = 0;
    /// Finds a file by name, blanks around the name ignored: as an absolute path, in the folder `basePath` (null:
    /// none), then in the folders of the path list `listName`. `result` is its path, or empty. A folder counts as
    /// found. In each place the name is tried as it stands, with "/" for "\", and, when it is all bytes, as UTF-8.
    virtual void findFile(std::wstring& result, const wchar_t* name, const wchar_t* basePath,
                          const wchar_t* listName) = 0;
};

/// @{
/// The controllers of the process and of the calling thread, here one object, to be cast to RnProcessController.
OVHOST_API RnCastable* RnGetProcessController();
OVHOST_API RnCastable* RnGetThreadProcessController();
/// @}

/// Receives the messages of the process, as `RnProcessController::report` says. The text is valid during the call.
using MessageReporter = std::function<void(int level, const wchar_t* text)>;

// Host side. All of this belongs to the process: set it while nothing is being imported, but for the reporter.

/// Who receives the messages; null: standard error, a line each. The result is the previous one, which other threads
/// call no more once this has returned. A reporter may be replaced from inside its own call.
OVHOST_API MessageReporter setMessageReporter(MessageReporter reporter);
/// The folders of a path list. Readers look for the files that theirs name in those of "WebPathList".
OVHOST_API void setPathList(const std::wstring& listName, std::vector<std::wstring> folders);
/// Lets an object stand in for the controller, which is kept; null is passed on as null.
OVHOST_API void setProcessController(RnCastable* controller);
/// Brings the host's own back.
OVHOST_API void resetProcessController();

}  // namespace Ov
