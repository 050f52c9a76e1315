// Numbers as the person's locale writes them. Models know '.' only.
#pragma once

#include <QString>

#include <optional>
#include <string>

/// A number's text with the decimal separator of the default locale; all its digits stay.
QString LocalNumberText(const std::string& plain);

/// What a person typed as a number's text with '.': blanks at the ends go; the decimal separator
/// may be the locale's or '.'. Digits in groups are not accepted anywhere: they stay as they are,
/// so that the text is no number.
std::string PlainNumberText(const QString& typed);

/// The typed text as a finite number.
std::optional<double> ParseLocalNumber(const QString& typed);
