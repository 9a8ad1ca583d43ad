#include "components/messageFile/message.h"

#include <set>

#include "components/messageFile/messageStore.h"
#include "components/support/immortal.h"
#include "components/support/path.h"

namespace Ov {

namespace {

constexpr char source[] = "components/messageFile/message";

// What the exceptions carry as the place where they were raised.
constexpr int lineNoFilename = 145;
constexpr int lineNoCatalogue = 160;

/// Each text that was asked for, once.
struct KeptTexts {
    std::mutex lock;
    std::set<std::wstring> texts;
};

}  // namespace

RnMessageFile::RnMessageFile() = default;
RnMessageFile::~RnMessageFile() = default;

void RnMessageFile::setFileName(const wchar_t* path) {
    std::wstring name = path ? path : L"";
    const std::lock_guard guard(_lock);
    _fileName.swap(name);
    _store.reset();
}

std::wstring RnMessageFile::fileName() const {
    const std::lock_guard guard(_lock);
    return _fileName;
}

std::shared_ptr<const RnMessageFile::Store> RnMessageFile::store() {
    const std::lock_guard guard(_lock);
    if (!_store && !_fileName.empty()) _store = Store::open(_fileName);
    return _store;
}

std::wstring RnMessageFile::getText(unsigned id) {
    if (const auto found = store()) return found->text(id);
    const std::wstring name = fileName();
    if (name.empty()) throw RnMessageFileEx::ExNoFilename();
    throw RnMessageFileEx::ExNoCatalogue(name);
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

RnMessageFile& messageFile() { return immortal<RnMessageFile>(); }

const wchar_t* keptText(Message<> message) {
    std::wstring text = messageFile().format(message);
    auto& kept = immortal<KeptTexts>();
    const std::lock_guard guard(kept.lock);
    return kept.texts.insert(std::move(text)).first->c_str();
}

void releaseTexts() {
    messageFile().setFileName(nullptr);
    auto& kept = immortal<KeptTexts>();
    const std::lock_guard guard(kept.lock);
    kept.texts.clear();
}

}  // namespace Ov
