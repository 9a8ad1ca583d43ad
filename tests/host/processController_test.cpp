#include "host/componentManager/processController.h"

#include <gmock/gmock.h>

#include "host/componentManager/castImpl.h"
#include "host/platform/path.h"
#include "support/tempFolder.h"

namespace Ov {
namespace {

RnRef<RnProcessController> controller() { return rnCast<RnProcessController>(RnGetThreadProcessController()); }

TEST(MessageReporter, MessagesGoToTheLastOneSet) {
    std::vector<std::wstring> first, second;
    setMessageReporter([&](int level, const wchar_t* text) { first.push_back(std::to_wstring(level) + text); });
    controller()->report(0, L"a");
    const auto previous = setMessageReporter([&](int, const wchar_t* text) { second.push_back(text); });
    controller()->report(0, L"b");
    setMessageReporter(previous);
    controller()->report(3, L"c");
    setMessageReporter(nullptr);
    EXPECT_THAT(first, testing::ElementsAre(L"0a", L"3c"));
    EXPECT_THAT(second, testing::ElementsAre(L"b"));

    testing::internal::CaptureStderr();
    controller()->report(0, L"l\xE4mp\xDCFF");
    controller()->report(0, nullptr);
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "l\xC3\xA4mp\xFF\n\n");
}

class CountedController : public RnCastHeap<RnCastImpl<RnProcessController, RnProcessController>> {
public:
    explicit CountedController(int& reports) : _reports(reports) {}
    ~CountedController() override { _reports = -1; }
    void report(int, const wchar_t*) override { ++_reports; }
    void findFile(std::wstring&, const wchar_t*, const wchar_t*, const wchar_t*) override {}

private:
    int& _reports;
};

TEST(ProcessController, AnotherOrNoneCanStandIn) {
    int reports = 0;
    RnRef<RnProcessController> other = rnCreate<CountedController>(reports);
    setProcessController(other.get());
    other = {};
    rnCast<RnProcessController>(RnGetProcessController())->report(0, L"");
    controller()->report(0, L"");
    EXPECT_EQ(reports, 2);
    setProcessController(nullptr);
    EXPECT_EQ(reports, -1) << "let go of";
    EXPECT_EQ(RnGetProcessController(), nullptr);
    EXPECT_EQ(RnGetThreadProcessController(), nullptr);
    resetProcessController();
    EXPECT_TRUE(rnQuery<RnProcessController>(RnGetProcessController()));
}

class FindFile : public testing::Test {
protected:
    ~FindFile() override { setPathList(L"Lamps", {}); }

    /// What is found, as a path in the folder of the test; "-" when nothing is.
    std::string find(const std::wstring& name, const char* base = "base", const wchar_t* list = L"Lamps") const {
        std::wstring result = L"left over";
        const std::wstring basePath = base ? folder.wide(base) : L"";
        controller()->findFile(result, name.c_str(), base ? basePath.c_str() : nullptr, list);
        if (result.empty()) return "-";
        return nativePath(result).lexically_relative(folder.path()).string();
    }

    TempFolder folder;
};

TEST_F(FindFile, PlacesAreSearchedInOrder) {
    for (const char* file : {"base/a", "one/a", "one/b", "two/b", "two/c", "elsewhere"}) folder.write(file, "x");
    setPathList(L"Lamps", {folder.wide("one"), L"", folder.wide("two")});
    EXPECT_EQ(find(L"a"), "base/a");
    EXPECT_EQ(find(L"a", nullptr), "one/a");
    EXPECT_EQ(find(L"b"), "one/b");
    EXPECT_EQ(find(L"c"), "two/c");
    EXPECT_EQ(find(L"d"), "-");
    EXPECT_EQ(find(L"b", "base", L"Other"), "-");
    EXPECT_EQ(find(L"b", "base", nullptr), "-");
    EXPECT_EQ(find(folder.wide("elsewhere")), "elsewhere");
    EXPECT_EQ(find(folder.wide("absent")), "-");
    setPathList(L"Lamps", {folder.wide("two")});
    EXPECT_EQ(find(L"b"), "two/b");
}

TEST_F(FindFile, NothingIsFoundWithoutAPlaceOrName) {
    const std::filesystem::path before = std::filesystem::current_path();
    folder.write("base/a", "x");
    std::filesystem::current_path(folder.path() / "base");
    EXPECT_EQ(find(L"a", nullptr), "-");
    std::filesystem::current_path(before);

    EXPECT_EQ(find(L""), "-");
    EXPECT_EQ(find(L" \t"), "-");
    EXPECT_EQ(find(std::wstring(5000, L'x')), "-");
    std::wstring result = L"left over";
    controller()->findFile(result, nullptr, folder.wide("base").c_str(), nullptr);
    EXPECT_EQ(result, L"");
}

TEST_F(FindFile, NamesAreTakenAsMakersWriteThem) {
    for (const char* file : {"base/my lamp.tlt", "base/sub/lamp.tlt", "base/sub\\odd.tlt", "base/sub/odd.tlt",
                             "base/\xC3\xA9.tlt", "base/\xE9.tlt", "base/\xE8.tlt", "base/\xC3\xBC/l.tlt"}) {
        folder.write(file, "x");
    }
    const struct {
        const wchar_t* name;
        const char* found;
    } cases[] = {
        {L" \tmy lamp.tlt \t", "base/my lamp.tlt"},
        {L"sub\\lamp.tlt", "base/sub/lamp.tlt"},
        {L"sub\\odd.tlt", "base/sub\\odd.tlt"},       // as it stands comes first
        {L"\xE9.tlt", "base/\xC3\xA9.tlt"},           // the character
        {L"\xC3\xA9.tlt", "base/\xC3\xA9.tlt"},       // its two bytes
        {L"\xE8.tlt", "base/\xE8.tlt"},               // a byte that is no UTF-8
        {L"\xC3\xBC\\l.tlt", "base/\xC3\xBC/l.tlt"},  // bytes and the other slash
        {L"sub", "base/sub"},
        {L"\x20AC\xC3\xA9.tlt", "-"},
    };
    for (const auto& c : cases) EXPECT_EQ(find(c.name), c.found) << toUtf8(c.name);
}

}  // namespace
}  // namespace Ov
