// SPDX-License-Identifier: Apache-2.0
#include "TraceBook.h"

#include <gtest/gtest.h>
#include <stdlib.h>
#include <string.h>

#include <filesystem>
#include <fstream>
#include <map>
#include <mutex>
#include <set>
#include <sstream>

#include "PlatformCalls.h"

namespace orvtest {
namespace {

constexpr char kPageMark[] = "== ";

using Pages = std::map<std::string, std::string>;  // by the test's name

std::mutex sMutex;
std::string sPage;  // of the running test

// The suite's name without that of its instantiation.
std::string suiteOf(const std::string& name) {
    const size_t slash = name.find('/');
    return slash == std::string::npos ? name : name.substr(slash + 1);
}

std::string fileOf(const std::string& suite) {
    return std::string(ORV_TRACES) + "/" + suiteOf(suite) + ".txt";
}

Pages readPages(const std::string& file) {
    Pages pages;
    std::ifstream in(file);
    std::string* page = nullptr;
    for (std::string line; std::getline(in, line);) {
        if (line.rfind(kPageMark, 0) == 0) {
            page = &pages[line.substr(strlen(kPageMark))];
        } else if (page != nullptr) {
            *page += line + "\n";
        }
    }
    return pages;
}

void writePages(const std::string& file, const Pages& pages) {
    std::ofstream out(file);
    for (const auto& [name, page] : pages) out << kPageMark << name << "\n" << page;
    if (!out.flush()) ADD_FAILURE() << "cannot write " << file;
}

// Where the platform's helpers are inline, a page with one has other steps.
bool isComparable(const std::string& page) {
    const bool hasHelper = page.find("    throw ") != std::string::npos ||
                           page.find("    platform jni") != std::string::npos;
    return !hasHelper || !platformHelpersAreInline();
}

class PageCheck : public testing::EmptyTestEventListener {
    void OnTestStart(const testing::TestInfo&) override {
        std::lock_guard<std::mutex> lock(sMutex);
        sPage.clear();
    }

    void OnTestEnd(const testing::TestInfo& test) override {
        std::lock_guard<std::mutex> lock(sMutex);
        const std::string name = std::string(test.test_suite_name()) + "." + test.name();
        const std::string file = fileOf(test.test_suite_name());
        Pages pages = readPages(file);
        if (test.result()->Skipped() || !isComparable(pages[name])) return;
        if (getenv("ORV_ACCEPT_TRACES") == nullptr) {
            EXPECT_EQ(pages[name], sPage)
                << "the order of effects in " << name << " is not that of " << file;
            return;
        }
        if (pages[name] == sPage) return;
        pages[name] = sPage;
        if (sPage.empty()) pages.erase(name);
        writePages(file, pages);
    }
};

// Ahead of the printers: they report what it finds as the test's own.
const bool sInstalled = [] {
    testing::UnitTest::GetInstance()->listeners().Append(new PageCheck);
    return true;
}();

std::set<std::string> testNames() {
    std::set<std::string> names;
    const testing::UnitTest& program = *testing::UnitTest::GetInstance();
    for (int i = 0; i < program.total_test_suite_count(); i++) {
        const testing::TestSuite& suite = *program.GetTestSuite(i);
        for (int j = 0; j < suite.total_test_count(); j++) {
            names.insert(std::string(suite.name()) + "." + suite.GetTestInfo(j)->name());
        }
    }
    return names;
}

}  // namespace

void addToTracePage(const std::string& call, const std::vector<std::string>& steps) {
    std::lock_guard<std::mutex> lock(sMutex);
    sPage += call + "\n";
    for (const std::string& step : steps) sPage += "    " + step + "\n";
}

// A page of a test that is gone would stay for ever.
TEST(TraceBookTest, EachPageIsOfATest) {
    const std::set<std::string> names = testNames();
    for (const auto& file : std::filesystem::directory_iterator(ORV_TRACES)) {
        for (const auto& [name, page] : readPages(file.path())) {
            EXPECT_EQ(1u, names.count(name)) << name << " of " << file.path();
        }
    }
}

}  // namespace orvtest
