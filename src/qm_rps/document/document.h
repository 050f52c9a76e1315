// A document that is handed in: a head and chapters of paragraphs, tables, formulas and pictures.
// Texts are in the chosen language. HTML and pages are printed from this structure and add nothing.
#pragma once

#include "qm_rps/dialog/texttable.h"
#include "qm_rps/document/docpicture.h"
#include "qm_rps/pushover/explain/fact.h"

#include <array>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

/// What a line says beside its words; printed as colour and, for prints in black, as a mark.
enum class DOC_TONE { Plain, Good, Bad, Warning };

struct T_DOC_TEXT {
    std::string text;
    DOC_TONE tone = DOC_TONE::Plain;
};

struct T_DOC_TABLE {
    std::string caption;
    T_TEXT_TABLE table;
    std::vector<DOC_TONE> tones{}; // by row; empty: all plain
};

struct T_DOC_FACTS {
    std::string caption;
    std::vector<T_FACT> facts;
};

/// Lines of a code's trace have no definitions; inputs have no symbols.
bool HasDefinitions(const T_DOC_FACTS& facts);
bool HasSymbols(const T_DOC_FACTS& facts);

using T_DOC_BLOCK = std::variant<T_DOC_TEXT, T_DOC_TABLE, T_DOC_FACTS, T_DOC_PICTURE>;

struct T_DOC_CHAPTER {
    std::string title;
    std::vector<T_DOC_BLOCK> blocks{};
    std::vector<T_DOC_CHAPTER> parts{};
};

/// Rows of the title block: what it is and what stands there; empty ones are lines to write on.
struct T_DOC_HEAD_ROW {
    std::string name, value;
};

/// Words that printers add.
struct T_DOC_WORDS {
    /// Heads of facts: symbol, what it is, value, formula, source.
    std::array<std::string, 5> factHeads{};
    std::string page; // "Page {1} of {2}"
    std::string cut;  // behind what is too long for a page: "... ({1} characters in all)"
};

struct T_DOCUMENT {
    std::string language; // "en", "it"
    std::string title, subtitle;
    std::string program; // name and version
    std::vector<T_DOC_HEAD_ROW> head;
    std::string contents; // "Contents"
    std::vector<T_DOC_CHAPTER> chapters;
    std::vector<std::string> signOff; // who signs, one line each
    std::string signOffTitle;
    T_DOC_WORDS words;
};

/// A text as a document may hold it: what is no UTF-8, control characters but tab and line feed,
/// and those that turn the direction of what follows are U+FFFD. Letters of any script stay.
std::string CleanText(std::string_view text);

/// "1", "1.2": the number of a chapter from those of its place.
std::string ChapterNumber(const std::vector<std::size_t>& place);
