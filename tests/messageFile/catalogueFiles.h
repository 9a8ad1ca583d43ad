#pragma once

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include "host/sdk/util.h"
#include "tests/support/tempFolder.h"

/// Compiled catalogues of one test, in a folder of its own. The language is none, until the test sets one.
class CatalogueFiles : public testing::Test {
protected:
    CatalogueFiles() { WendSDK::Util::setLanguage(L""); }
    ~CatalogueFiles() override { WendSDK::Util::setLanguage(L""); }

    /// Compiles messages ("5 text", one a line) to a file of the folder; its wide path.
    std::wstring compile(const std::string& name, const std::string& messages) {
        folder.write("source.msg", "$ codeset=UTF-8\n$set 1\n" + messages + "\n");
        const std::filesystem::path file = folder.path() / name;
        std::filesystem::create_directories(file.parent_path());
        const std::string command =
            "LC_ALL=C gencat '" + file.string() + ".new' '" + folder.path().string() + "/source.msg'";
        EXPECT_EQ(std::system(command.c_str()), 0) << command;
        std::filesystem::rename(file.string() + ".new", file);
        return Ov::widePath(file);
    }

    std::string bytesOf(const std::wstring& file) {
        std::ifstream in(Ov::nativePath(file), std::ios::binary);
        return {std::istreambuf_iterator<char>(in), {}};
    }

    TempFolder folder;
};
