#include "host/componentManager/processController.h"

#include <algorithm>
#include <cstdio>
#include <map>
#include <memory>
#include <mutex>

#include "components/support/castImpl.h"
#include "components/support/immortal.h"
#include "components/support/path.h"

namespace Ov {

namespace {

namespace fs = std::filesystem;

std::wstring withoutBlanks(const std::wstring& text) {
    const std::size_t first = text.find_first_not_of(L" \t");
    if (first == std::wstring::npos) return {};
    return text.substr(first, text.find_last_not_of(L" \t") + 1 - first);
}

void addUnlessEqual(std::vector<fs::path>& names, const std::wstring& name) {
    const fs::path native = nativePath(name);
    if (std::find(names.begin(), names.end(), native) == names.end()) names.push_back(native);
}

/// The characters of `name` as the bytes of a UTF-8 text; the name itself where they are no bytes.
std::wstring fromBytes(const std::wstring& name) {
    std::string bytes;
    for (const wchar_t c : name) {
        if (static_cast<char32_t>(c) > 0xFF) return name;
        bytes += static_cast<char>(c);
    }
    return fromUtf8(bytes);
}

/// The names that `name` may stand for: files come from systems with the other slash, and a reader that takes a
/// byte for a character leaves UTF-8 undone.
std::vector<fs::path> spellings(const std::wstring& name) {
    std::vector<fs::path> names;
    for (std::wstring spelling : {name, fromBytes(name)}) {
        addUnlessEqual(names, spelling);
        std::replace(spelling.begin(), spelling.end(), L'\\', L'/');
        addUnlessEqual(names, spelling);
    }
    return names;
}

bool isThere(const fs::path& path) {
    std::error_code ignored;
    return fs::exists(path, ignored);
}

/// The first of `names` that is there, in `folder` or, without one, by itself as an absolute path; else empty.
fs::path findIn(const fs::path& folder, const std::vector<fs::path>& names) {
    for (const fs::path& name : names) {
        if (name.is_absolute() == folder.empty() && isThere(folder / name)) return folder / name;
    }
    return {};
}

void reportToStandardError(const wchar_t* text) {
    const std::string line = toUtf8(text) + '\n';
    std::fwrite(line.data(), 1, line.size(), stderr);
}

class HostController final : public RnCastImpl<RnProcessController, RnProcessController> {
public:
    void report(int level, const wchar_t* text) override;
    void findFile(std::wstring& result, const wchar_t* name, const wchar_t* basePath,
                  const wchar_t* listName) override;

    std::recursive_mutex reporting;  // held while a message is reported; again when the reporter causes another
    std::shared_ptr<const MessageReporter> reporter;  // null: standard error
    std::map<std::wstring, std::vector<std::wstring>> pathLists;

private:
    std::vector<fs::path> searchFolders(const wchar_t* basePath, const wchar_t* listName) const;
};

void HostController::report(int level, const wchar_t* text) {
    if (!text) text = L"";
    const std::lock_guard guard(reporting);
    if (const auto current = reporter) {  // stays while it is called, even if it sets another
        (*current)(level, text);
    } else {
        reportToStandardError(text);
    }
}

void HostController::findFile(std::wstring& result, const wchar_t* name, const wchar_t* basePath,
                              const wchar_t* listName) {
    const std::wstring wanted = withoutBlanks(name ? name : L"");
    const std::vector<fs::path> folders = searchFolders(basePath, listName);
    result.clear();
    if (wanted.empty()) return;

    const std::vector<fs::path> names = spellings(wanted);
    for (const fs::path& folder : folders) {
        const fs::path found = findIn(folder, names);
        if (!found.empty()) {
            result = widePath(found);
            return;
        }
    }
}

/// The first, empty, stands for absolute names.
std::vector<fs::path> HostController::searchFolders(const wchar_t* basePath, const wchar_t* listName) const {
    std::vector<fs::path> folders(1);
    const auto add = [&](const std::wstring& folder) {
        if (!folder.empty()) folders.push_back(nativePath(folder));
    };
    add(basePath ? basePath : L"");
    const auto list = pathLists.find(listName ? listName : L"");
    if (list != pathLists.end()) std::for_each(list->second.begin(), list->second.end(), add);
    return folders;
}

/// A module may report until the process ends.
HostController& hostController() { return immortal<HostController>(); }

struct CurrentController {
    RnRef<RnCastable> object = RnRef<RnCastable>::share(&hostController());
};

RnRef<RnCastable>& currentController() { return immortal<CurrentController>().object; }

}  // namespace

RnCastable* RnGetProcessController() { return currentController().get(); }

RnCastable* RnGetThreadProcessController() { return currentController().get(); }

MessageReporter setMessageReporter(MessageReporter reporter) {
    auto next = reporter ? std::make_shared<const MessageReporter>(std::move(reporter)) : nullptr;
    const std::lock_guard guard(hostController().reporting);
    const auto previous = std::exchange(hostController().reporter, std::move(next));
    return previous ? *previous : nullptr;
}

void setPathList(const std::wstring& listName, std::vector<std::wstring> folders) {
    hostController().pathLists[listName] = std::move(folders);
}

void setProcessController(RnCastable* controller) { currentController() = RnRef<RnCastable>::share(controller); }

void resetProcessController() { setProcessController(&hostController()); }

}  // namespace Ov
