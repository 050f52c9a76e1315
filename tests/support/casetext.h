// Case file texts in tests: read, print, go through both file forms, spoil.
#pragma once

#include "modelstoresample.h"
#include "qm_db/casefile.h"
#include "qm_db/filectrl.h"

#include <array>
#include <gtest/gtest.h>
#include <sstream>

inline std::string CaseText(const char* name)
{
    std::string text;
    T_FILE_ERROR error;
    EXPECT_EQ(1, CFileCtrl::ReadWholeFile(std::string(QM_TEST_DATA "/cases/") + name, text, error));
    return text;
}

inline T_MODEL_CONTENT ParseGood(const std::string& text)
{
    T_MODEL_CONTENT content;
    T_FILE_ERROR error;
    EXPECT_EQ(1, CCaseFile::Parse(text, "case.json", "", content, error)) << error.text;
    return content;
}

inline std::string PrintGood(const T_MODEL_CONTENT& content)
{
    std::string text;
    T_FILE_ERROR error;
    EXPECT_EQ(1, CCaseFile::Print(content, text, error)) << error.text;
    return text;
}

/// Through both file forms; the model must come back equal, and its text too.
inline void ExpectRoundTrips(const T_MODEL_CONTENT& content, const std::string& label)
{
    const CTempFolder folder;
    const std::string path = folder.File("m.qmdb");
    const std::string text = PrintGood(content);
    EXPECT_TRUE(SameContent(content, ParseGood(text))) << label;
    T_MODEL_CONTENT stored;
    T_FILE_ERROR error;
    ASSERT_EQ(1, CModelStore().Save(path, content, error)) << label << error.text;
    ASSERT_EQ(1, CModelStore().Open(path, OPEN_MODE::ReadOnly, stored, error)) << error.text;
    EXPECT_TRUE(SameContent(content, stored)) << label;
    EXPECT_EQ(text, PrintGood(stored)) << label;
}

/// A value goes through every pair of units without losing a bit.
inline void ExpectLosslessInEveryUnit(const T_MODEL_CONTENT& content)
{
    for (int i = 0; i < 35; ++i) {
        T_MODEL_CONTENT other = content;
        other.model.styp.units = {static_cast<FORCE_UNIT>(i % 7), static_cast<LENGTH_UNIT>(i / 7)};
        const T_MODEL_CONTENT once = ParseGood(PrintGood(other));
        EXPECT_EQ(PrintGood(other), PrintGood(once)) << i;
        EXPECT_TRUE(SameContent(once, ParseGood(PrintGood(once)))) << i;
    }
}

/// Rows of a file of refusals: four texts apart by tabs (piece before the spot, what is replaced,
/// by what, message without the file), with \\n and \\t for what a row can't hold.
inline std::vector<std::array<std::string, 4>> RefusalRows(const char* name)
{
    std::vector<std::array<std::string, 4>> rows;
    std::istringstream lines(CaseText(name));
    for (std::string line; std::getline(lines, line);) {
        if (line.empty() || line.front() == '#') continue;
        std::size_t column = 0;
        auto& row = rows.emplace_back();
        for (std::size_t i = 0; i < line.size(); ++i) {
            const bool escaped = line[i] == '\\' && i + 1 < line.size();
            if (line[i] == '\t')
                ++column;
            else if (escaped)
                row.at(column) += line[++i] == 'n' ? '\n' : line[i] == 't' ? '\t' : line[i];
            else
                row.at(column) += line[i];
        }
    }
    return rows;
}

/// Each row of the file alone is refused with its message and leaves the content as it was.
inline void ExpectRefused(const std::string& good, const char* refusals)
{
    const T_MODEL_CONTENT before = ParseGood(good);
    const auto rows = RefusalRows(refusals);
    EXPECT_FALSE(rows.empty());
    for (const auto& [after, from, to, message] : rows) {
        std::string text = good;
        const std::size_t at = text.find(from, text.find(after));
        ASSERT_NE(std::string::npos, text.find(after)) << after;
        ASSERT_NE(std::string::npos, at) << from;
        text.replace(at, from.size(), to);
        T_MODEL_CONTENT content = before;
        T_FILE_ERROR error;
        EXPECT_EQ(0, CCaseFile::Parse(text, "f", "", content, error)) << to;
        EXPECT_TRUE(SameContent(before, content)) << to;
        EXPECT_EQ(FILE_FAULT::BadInput, error.fault) << error.text;
        EXPECT_EQ("f: " + message, error.text);
    }
}
