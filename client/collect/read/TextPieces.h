#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace NORVZEL20 {

/// Without blanks, tabs and line ends in front and behind.
std::string_view Trimmed(std::string_view text);

/// The pieces between the separators; one for a text without any, even if it is empty.
std::vector<std::string_view> SplitAt(std::string_view text, char separator);

/// The pieces between runs of blanks and tabs.
std::vector<std::string_view> SplitAtBlanks(std::string_view text);

/// The same as texts, for arrays of a separated list without empty pieces.
std::vector<std::string> ListOf(std::string_view text, char separator);

bool StartsWith(std::string_view text, std::string_view start);
bool EndsWith(std::string_view text, std::string_view end);

/// A short piece of a text in quotation marks, for messages.
std::string Quoted(std::string_view text);

}  // namespace NORVZEL20
