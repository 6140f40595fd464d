#include <gtest/gtest.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <functional>

#include "documents/JsonReader.h"
#include "host/scenario/ScenarioReader.h"
#include "linux/configuration/ConfigurationReader.h"
#include "linux/configuration/PreferencesFile.h"
#include "linux/positions/TrackReader.h"
#include "serve/FaultScript.h"
#include "serve/FriendsReader.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

namespace {

using documents::DocumentError;
using documents::DocumentWarnings;

/// One reader of documents, as a function from a file to its error in one line; empty when there is none.
struct Reader {
    const char* name;
    std::function<std::string(const std::string& file, DocumentWarnings&)> read;
    std::string good;       ///< the members of a document that it reads
    std::string wrongType;  ///< members, one of them of another type
    std::string misspelt;   ///< members, one of them unknown; empty where every name is one
    bool isMissingFine = false;
};

template <class Result>
std::string lineOf(const Result& result) {
    const auto* error = std::get_if<DocumentError>(&result);
    return error == nullptr ? "" : error->text();
}

std::vector<Reader> allReaders() {
    const std::string place = R"({"latitude": 1, "longitude": 2})";
    return {
        {"scenario",
         [](const std::string& file, DocumentWarnings& warnings) {
             return lineOf(host::ScenarioReader({0.0}).readFile(file, &warnings));
         },
         R"("sentence": "a")", R"("sentence": "a", "dark": 1)", R"("sentence": "a", "langauge": "en")"},
        {"friends",
         [](const std::string& file, DocumentWarnings& warnings) {
             return lineOf(serve::FriendsReader::readFile(file, &warnings));
         },
         R"("friends": [])", R"("friends": {})", R"("friends": [], "intervalSecond": 3)"},
        {"faults",
         [](const std::string& file, DocumentWarnings& warnings) {
             return lineOf(serve::FaultScript::readFile(file, &warnings));
         },
         R"("faults": [])", R"("faults": [{"at": "x"}])", R"("faults": [], "fault": 1)"},
        {"configuration",
         [](const std::string& file, DocumentWarnings& warnings) {
             const auto read = linux_::ConfigurationReader::readFile(file, &warnings);
             const auto* error = std::get_if<linux_::ConfigurationReader::Error>(&read);
             return error == nullptr ? "" : error->text;
         },
         R"("language": "en")", R"("language": 1)", R"("langauge": "en")", true},
        {"preferences",
         [](const std::string& file, DocumentWarnings&) {
             const auto read = linux_::PreferencesFile::read(file);
             const auto* error = std::get_if<linux_::PreferencesFile::Error>(&read);
             return error == nullptr ? "" : error->text;
         },
         R"("host": "a")", R"("host": 1)", "", true},
        {"track",
         [](const std::string& file, DocumentWarnings& warnings) {
             return lineOf(linux_::TrackReader::readFile(file, &warnings));
         },
         R"("positions": [)" + place + "]", R"("positions": [{"latitude": "x"}])",
         R"("positions": [{"latitude": 1, "longitude": 2, "acuracy": 3}])"},
    };
}

}  // namespace

/// Every rule about documents holds for every reader of documents.
class BadDocumentsTest : public ::testing::TestWithParam<Reader> {
  protected:
    std::string errorOfFile(const std::string& file) {
        warnings.clear();
        return GetParam().read(file, warnings);
    }
    std::string errorOf(const std::string& text) { return errorOfFile(folder.write("a.json", text).string()); }
    std::string document(const std::string& members) const { return "{" + members + "}"; }
    std::string path(const char* name) const { return (folder.path() / name).string(); }
    std::string file() const { return path("a.json"); }

    TemporaryFolder folder;
    DocumentWarnings warnings;
};

TEST_P(BadDocumentsTest, Good_IsReadWithoutAWord) {
    for (const std::string start : {"", "\xEF\xBB\xBF", "\n\t "}) {
        EXPECT_EQ(errorOf(start + document(GetParam().good) + "\n"), "");
        EXPECT_TRUE(warnings.empty());
    }
    EXPECT_EQ(errorOf(document(R"("$schema": "a.schema.json", )" + GetParam().good)), "");
    EXPECT_TRUE(warnings.empty());
}

TEST_P(BadDocumentsTest, WrongType_NamesFileLineAndPath) {
    const std::string error = errorOf("\n" + document(GetParam().wrongType));
    EXPECT_EQ(error.rfind(file() + ":2:", 0), 0U) << error;
    EXPECT_NE(error.find(": $."), std::string::npos) << error;
    EXPECT_NE(error.find(": expected "), std::string::npos) << error;
}

TEST_P(BadDocumentsTest, UnknownMember_IsAWarningWithTheNearestName) {
    if (GetParam().misspelt.empty()) {
        GTEST_SKIP() << "every name is one";
    }
    EXPECT_EQ(errorOf("\n" + document(GetParam().misspelt)), "");
    ASSERT_EQ(warnings.size(), 1U);
    const std::string warning = warnings.front().text();
    EXPECT_EQ(warning.rfind(file() + ":2:", 0), 0U) << warning;
    EXPECT_NE(warning.find("there is no such member"), std::string::npos) << warning;
    EXPECT_NE(warning.find("; did you mean \""), std::string::npos) << warning;
}

TEST_P(BadDocumentsTest, TextThatIsNoDocument_IsAnErrorWithItsPlace) {
    const std::string& good = GetParam().good;
    const std::string texts[] = {"",
                                 "null",
                                 "3",
                                 "\"" + good.substr(1, 4) + "\"",
                                 "[]",
                                 "{",
                                 document(good) + "}",
                                 document(good + ","),
                                 document(good + ", " + good),
                                 document("/* a */" + good),
                                 document("'a': 1"),
                                 document(good + ", \"a\": \"\xFF\""),
                                 document(good + ", \"a\": \"\n\""),
                                 document(good + ", \"a\": 01"),
                                 document(good + ", \"a\": NaN"),
                                 document(good + ", \"a\": \"\\ud800\""),
                                 document(good + ", \"a\": " + std::string(100, '[') + std::string(100, ']')),
                                 "\xFF\xFE{\0}\0",
                                 std::string("\0", 1)};
    for (const std::string& text : texts) {
        const std::string error = errorOf(text);
        EXPECT_EQ(error.rfind(file() + ":1:", 0), 0U) << text << ": " << error;
        EXPECT_EQ(error.find_first_of("\n\r\x1b"), std::string::npos) << error;
    }
}

TEST_P(BadDocumentsTest, WhatIsNoFile_IsAnErrorAtOnce) {
    const auto start = std::chrono::steady_clock::now();
    ASSERT_EQ(::mkfifo(path("pipe").c_str(), 0600), 0);
    EXPECT_EQ(errorOfFile(path("pipe")), path("pipe") + ": this is a pipe, not a file");
    EXPECT_EQ(errorOfFile(folder.path().string()), folder.path().string() + ": this is a folder, not a file");
    EXPECT_EQ(errorOfFile("/dev/zero"), "/dev/zero: this is a device, not a file");
    EXPECT_EQ(errorOfFile(path("missing")),
              GetParam().isMissingFine ? "" : path("missing") + ": there is no such file");
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(5));
}

TEST_P(BadDocumentsTest, FileThatCannotBeRead_SaysWhy) {
    // Reading a process's memory at its first byte is an input/output error that every machine has.
    EXPECT_EQ(errorOfFile("/proc/self/mem"), "/proc/self/mem: the file cannot be read: Input/output error");
    const std::string locked = folder.write("locked.json", document(GetParam().good), 0000).string();
    const pid_t child = ::fork();
    if (child == 0) {
        // Root reads everything.
        const bool nobody = ::geteuid() != 0 || (::chmod(folder.path().c_str(), 0755) == 0 && ::seteuid(65534) == 0);
        ::_exit(nobody && errorOfFile(locked) == locked + ": the file cannot be read: Permission denied" ? 0 : 1);
    }
    int status = 0;
    ASSERT_EQ(::waitpid(child, &status, 0), child);
    EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
}

TEST_P(BadDocumentsTest, FileBeyondItsSize_IsNotRead) {
    const auto large = folder.write("large.json", document(GetParam().good));
    // A hole costs no disk; read in, it would cost all memory.
    std::filesystem::resize_file(large, std::uintmax_t{6} << 30);
    const std::string error = errorOfFile(large.string());
    EXPECT_EQ(error.rfind(large.string() + ": the file is larger than ", 0), 0U) << error;
}

TEST_P(BadDocumentsTest, TenThousandUnknownMembers_AreAFewLines) {
    if (GetParam().misspelt.empty()) {
        GTEST_SKIP() << "every name is one";
    }
    std::string members = GetParam().good;
    for (int i = 0; i < 10'000; ++i) {
        members += ", \"unknown" + std::to_string(i) + "\": 1";
    }
    EXPECT_EQ(errorOf(document(members)), "");
    // What a track does not know of a scenario is a scenario's.
    if (std::string(GetParam().name) != "track") {
        ASSERT_EQ(warnings.size(), 9U);
        EXPECT_EQ(warnings.back().text(), file() + ": members that there are not, passed over: 9992 more");
    }
}

INSTANTIATE_TEST_SUITE_P(Readers, BadDocumentsTest, ::testing::ValuesIn(allReaders()),
                         [](const auto& reader) { return std::string(reader.param.name); });

}  // namespace ktr::test
