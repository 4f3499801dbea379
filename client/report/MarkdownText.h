#pragma once

#include <string>
#include <string_view>

namespace NORVZEL20 {

/// A line of text as GitHub-flavoured Markdown that shows exactly this text: no markup, no link to an issue, no mention of a
/// person, no picture for a word between colons.
std::string EscapeForMarkdown(std::string_view text);

/// The same in the letters of code, also within a table. Nothing in it has a meaning.
std::string MarkdownCode(std::string_view text);

/// The same within HTML.
std::string HtmlCode(std::string_view text);

/// Lines of text as a block of code. `text` ends with a line end.
std::string MarkdownBlock(std::string_view text);

}  // namespace NORVZEL20
