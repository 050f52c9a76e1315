// Text from outside, made safe to show on a terminal.
#pragma once

#include <string>
#include <string_view>

/// Passes text on with what a terminal would obey shown as an escape: control characters ("\x1b"),
/// those of C1 and marks that change the direction of writing ("\u009b", "\u202e"), and bytes that
/// are no UTF-8 ("\xff"). Line ends and tabs pass. State: the begin of a character whose end
/// has not come yet.
class CVisibleText {
public:
    /// The next piece of a text, as it may be shown.
    std::string Next(std::string_view piece);
    /// What is left of a character that was cut off.
    std::string Rest();

private:
    std::string m_open; // bytes of an unfinished character
};

/// A line: line ends and tabs are escapes as well ("\n").
std::string VisibleLine(std::string_view line);
