#include "components/messageFile/message.h"

#include "components/messageFile/messageStore.h"
#include "host/platform/path.h"

namespace Ov {

namespace {

constexpr char source[] = "components/messageFile/message";

// What the exceptions carry as the place where they were raised.
constexpr int lineNoFilename = 145;
constexpr int lineNoCatalogue = 160;

}  // namespace

RnMessageFile::RnMessageFile() = default;
RnMessageFile::~RnMessageFile() = default;

void RnMessageFile::setFileName(const wchar_t* path) {
    _fileName = path ? path : L"";
    _store.reset();
}

bool RnMessageFile::isThere() {
    if (!_store && !_fileName.empty()) _store = Store::open(_fileName);
    return _store != nullptr;
}

RnMessageFile::Store& RnMessageFile::store() {
    if (isThere()) return *_store;
    if (_fileName.empty()) throw RnMessageFileEx::ExNoFilename();
    throw RnMessageFileEx::ExNoCatalogue(_fileName);
}

std::wstring RnMessageFile::getText(unsigned id) { return store().text(id); }

std::wstring RnMessageFile::format(unsigned id, ...) {
    const std::wstring text = getText(id);
    std::va_list args;
    va_start(args, id);
    std::wstring result = formatMessageV(text.c_str(), args);
    va_end(args);
    return result;
}

std::wstring RnMessageFile::formatV(unsigned id, std::va_list args) {
    return formatMessageV(getText(id).c_str(), args);
}

RnMessageFileEx::RnMessageFileEx(const std::string& reason, int line)
    : ExBase(reason.c_str(), line), std::runtime_error(reason) {}

RnMessageFileEx::~RnMessageFileEx() = default;

std::string RnMessageFileEx::getDetailedReason() const {
    return std::string(getReason()) + " (" + source + ", line " + std::to_string(getCode()) + ")";
}

RnMessageFileEx::ExNoFilename::ExNoFilename() : RnMessageFileEx("Message filename not set.", lineNoFilename) {}
RnMessageFileEx::ExNoFilename::~ExNoFilename() = default;

RnMessageFileEx::ExNoCatalogue::ExNoCatalogue(const std::wstring& fileName)
    : RnMessageFileEx(toUtf8(fileName) + ": Cannot open message catalogue.", lineNoCatalogue) {}
RnMessageFileEx::ExNoCatalogue::~ExNoCatalogue() = default;

RnMessageFile& messageFile() {
    static RnMessageFile catalogue;
    return catalogue;
}

}  // namespace Ov
