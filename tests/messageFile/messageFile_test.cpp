#include <sys/stat.h>

#include "components/messageFile/message.h"
#include "tests/messageFile/catalogueFiles.h"

namespace {

using Ov::RnMessageFile;
using Ov::RnMessageFileEx;

class MessageFile : public CatalogueFiles {
protected:
    std::wstring textIn(const std::wstring& file, unsigned id = 5) {
        catalogue.setFileName(file.c_str());
        return catalogue.getText(id);
    }
    bool opens(const std::wstring& file) {
        try {
            textIn(file);
            return true;
        } catch (const RnMessageFileEx::ExNoCatalogue&) {
            return false;
        }
    }

    RnMessageFile catalogue;
};

TEST_F(MessageFile, LookupWithoutANameSaysSo) {
    for (int i = 0; i < 2; ++i) {
        try {
            catalogue.format(5);
            FAIL();
        } catch (const RnMessageFileEx::ExNoFilename& e) {
            EXPECT_STREQ(e.getReason(), "Message filename not set.");
            EXPECT_EQ(e.getDetailedReason(),
                      "Message filename not set. (components/messageFile/message, line 145)");
            EXPECT_EQ(e.getCode(), 145);
        }
        catalogue.setFileName(L"");
    }
    EXPECT_EQ(textIn(compile("a.cat", "5 five")), L"five");
    catalogue.setFileName(nullptr);
    EXPECT_THROW(catalogue.getText(5), std::runtime_error);
}

TEST_F(MessageFile, LookupWithoutTheFileNamesItAndTriesAgain) {
    const std::wstring file = folder.wide() + L"/Me\u00dfwerte.cat";
    catalogue.setFileName(file.c_str());
    for (int i = 0; i < 2; ++i) {
        try {
            catalogue.getText(5);
            FAIL();
        } catch (const RnMessageFileEx::ExNoCatalogue& e) {
            EXPECT_EQ(e.getReason(), Ov::toUtf8(file) + ": Cannot open message catalogue.");
            EXPECT_STREQ(static_cast<const std::runtime_error&>(e).what(), e.getReason());
            EXPECT_EQ(e.getCode(), 160);
        }
    }
    compile("Me\u00dfwerte.cat", "5 five");
    EXPECT_EQ(catalogue.getText(5), L"five");
    EXPECT_EQ(catalogue.fileName(), file);
}

TEST_F(MessageFile, RefusesWhatIsNoCatalogue) {
    std::filesystem::create_directory(folder.path() / "folder");
    ASSERT_EQ(mkfifo((folder.path() / "pipe").c_str(), 0600), 0);
    EXPECT_FALSE(opens(folder.wide("folder")));
    EXPECT_FALSE(opens(folder.wide() + L"/"));
    EXPECT_FALSE(opens(folder.wide("pipe")));
    EXPECT_FALSE(opens(folder.wide("a.cat") + L"/a.cat"));
    EXPECT_FALSE(opens(folder.write("text", "$set 1\n5 five, long enough for a header\n")));
    EXPECT_FALSE(opens(folder.write("zeros", std::string(5000, '\0'))));
    EXPECT_FALSE(opens(L"/proc/self/exe"));
}

TEST_F(MessageFile, RefusesACatalogueCutShortAnywhere) {
    const std::string small = bytesOf(compile("small.cat", "5 five\n6 six\n7 seven"));
    for (std::size_t length = 0; length < small.size(); ++length)
        EXPECT_FALSE(opens(folder.write("cut", small.substr(0, length)))) << length;
    EXPECT_TRUE(opens(folder.write("cut", small)));

    // Texts on pages that the file no longer has.
    const std::string large =
        bytesOf(compile("large.cat", "5 " + std::string(1900, 'a') + "\n6 " + std::string(9000, 'b')));
    for (std::size_t length = 0; length < large.size(); length += 512)
        EXPECT_FALSE(opens(folder.write("cut", large.substr(0, length)))) << length;
}

TEST_F(MessageFile, DamagedTablesAreRefusedOrHarmless) {
    const std::string whole = bytesOf(compile("a.cat", "5 five\n6 six\n7 seven"));
    for (std::size_t at = 0; at < whole.size(); ++at) {
        for (const int flip : {0x01, 0x80, 0xFF}) {
            std::string damaged = whole;
            damaged[at] = static_cast<char>(damaged[at] ^ flip);
            if (!opens(folder.write("damaged", damaged))) continue;
            for (unsigned id = 0; id < 10; ++id) EXPECT_LT(catalogue.getText(id).size(), whole.size());
        }
    }
}

TEST_F(MessageFile, TextsByNumber) {
    const std::string longText(5000, 'x');
    const std::wstring file = compile("a.cat", "1 one\n5 Lichtst\u00e4rke %1!d!\n6 " + longText + "\n65535 last");
    EXPECT_EQ(textIn(file), L"Lichtst\u00e4rke %1!d!");
    EXPECT_EQ(catalogue.format(5, 7), L"Lichtst\u00e4rke 7");
    EXPECT_EQ(catalogue.getText(6), std::wstring(5000, L'x'));
    EXPECT_EQ(catalogue.getText(65535), L"last");
    for (const unsigned id : {0u, 2u, 65536u, 65537u, 0x7FFFFFFFu, 0x80000001u, 0xFFFFFFFFu}) {
        EXPECT_EQ(catalogue.getText(id), L"") << id;
        EXPECT_EQ(catalogue.format(id, 7), L"") << id;
    }
}

TEST_F(MessageFile, AnOpenFileStaysUntilItsNameIsSetAgain) {
    const std::wstring file = compile("a.cat", "5 old");
    EXPECT_EQ(textIn(file), L"old");
    compile("a.cat", "5 new, and longer than the old one");
    EXPECT_EQ(catalogue.getText(5), L"old");
    std::filesystem::remove(Ov::nativePath(file));
    EXPECT_EQ(catalogue.getText(5), L"old");
    EXPECT_FALSE(opens(file));
    EXPECT_EQ(textIn(compile("a.cat", "5 newest")), L"newest");
}

TEST_F(MessageFile, TheLanguageSetInTheHostComesFirst) {
    const std::wstring file = compile("a.cat", "5 five\n6 six");
    compile("de/a.cat", "5 f\u00fcnf");
    folder.write("fr/a.cat", "no catalogue");
    const struct {
        const wchar_t* language;
        const wchar_t* text;
    } cases[] = {{L"", L"five"}, {L"de", L"f\u00fcnf"}, {L"it", L"five"}, {L"fr", L"five"}, {L"de", L"f\u00fcnf"}};
    for (const auto& c : cases) {
        WendSDK::Util::setLanguage(c.language);
        EXPECT_EQ(textIn(file), c.text);
        EXPECT_EQ(catalogue.fileName(), file);
    }
    // A pack stands alone: what it lacks is not looked for elsewhere. It is chosen when the file is opened.
    EXPECT_EQ(catalogue.getText(6), L"");
    WendSDK::Util::setLanguage(L"");
    EXPECT_EQ(catalogue.getText(5), L"f\u00fcnf");
}

TEST_F(MessageFile, ANameWithoutAFolderIsOneOfTheCurrentFolder) {
    compile("elsewhere/a.cat", "5 elsewhere");
    compile("elsewhere/b.cat", "5 elsewhere");
    compile("a.cat", "5 here");
    compile("de/a.cat", "5 hier");
    const std::filesystem::path before = std::filesystem::current_path();
    std::filesystem::current_path(folder.path());
    setenv("NLSPATH", (folder.path() / "elsewhere/%N").c_str(), 1);
    EXPECT_EQ(textIn(L"a.cat"), L"here");
    EXPECT_FALSE(opens(L"b.cat"));
    WendSDK::Util::setLanguage(L"de");
    EXPECT_EQ(textIn(L"a.cat"), L"hier");
    unsetenv("NLSPATH");
    std::filesystem::current_path(before);
}

}  // namespace
