// Case file texts in tests: read, print, go through both file forms, spoil.
#pragma once

#include "modelstoresample.h"
#include "qm_db/casefile.h"
#include "qm_db/filectrl.h"

#include <gtest/gtest.h>
#include <span>

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

/// One piece of a text replaced, the first one behind `after`, and what the reader says to it.
struct T_SPOILT {
    const char* after;
    const char* from;
    const char* to;
    const char* message; // without the file; null: no valid JSON, whatever its words
};

/// Each row alone is refused with its message and leaves the content as it was.
inline void ExpectRefused(const std::string& good, std::span<const T_SPOILT> rows)
{
    const T_MODEL_CONTENT before = ParseGood(good);
    for (const T_SPOILT& row : rows) {
        std::string text = good;
        const std::size_t after = text.find(row.after);
        const std::size_t at = text.find(row.from, after);
        ASSERT_NE(std::string::npos, after) << row.after;
        ASSERT_NE(std::string::npos, at) << row.from;
        text.replace(at, std::string(row.from).size(), row.to);
        T_MODEL_CONTENT content = before;
        T_FILE_ERROR error;
        EXPECT_EQ(0, CCaseFile::Parse(text, "f", "", content, error)) << row.to;
        EXPECT_TRUE(SameContent(before, content)) << row.to;
        EXPECT_EQ(FILE_FAULT::BadInput, error.fault) << error.text;
        if (row.message) {
            EXPECT_EQ(std::string("f: ") + row.message, error.text);
        }
    }
}
