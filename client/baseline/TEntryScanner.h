#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace NORVZEL20 {

/// Takes a line of a baseline apart into fields. Blanks and tabs separate fields, except within quotes, where a backslash takes the
/// next character as it is.
class TEntryScanner {
  public:
    /// `file` and `line` are for messages. `text` must outlive this.
    TEntryScanner(std::string_view text, std::string file, std::size_t line);

    /// The field that comes next; empty at the end of the line and in front of the `#` of a reason.
    const std::string& Peek() const { return fField; }
    /// Takes it. Errors: TClientError for quotes that are not closed and for escapes that nothing writes, also when the scanner is
    /// made.
    std::string Take();
    /// What stands behind the `#`, trimmed, once all fields are taken.
    std::string GetReason() const;

    /// The line from the next field on, for fields that blanks do not separate; empty if Peek is.
    std::string_view GetRest() const;
    /// Takes so many characters of it. Errors: those of Take.
    void Skip(std::size_t length);

    /// Behind the text in quotes that stands `offset` characters behind the beginning of the next field: how many characters that
    /// is from there. Errors: those of Take.
    std::size_t EndOfQuoted(std::size_t offset) const;

    /// Throws a TClientError that names the file, the line, the column of the next field and what it is. `expected` goes on with
    /// what can be done.
    [[noreturn]] void Refuse(const std::string& expected) const;
    /// The same for what stands so many characters behind the beginning of the next field.
    [[noreturn]] void RefuseAt(std::size_t offset, const std::string& expected) const;

  private:
    void Advance();
    void CheckQuotes(std::size_t begin, std::size_t end, std::size_t open) const;
    std::string WordAt(std::size_t position) const;
    [[noreturn]] void RefuseFound(std::size_t position, const std::string& field, const std::string& expected) const;
    [[noreturn]] void RefusePlace(std::size_t position, const std::string& what) const;

    const std::string_view fText;
    const std::string fFile;
    const std::size_t fLine;
    std::size_t fBegin = 0;  // of the next field
    std::size_t fEnd = 0;
    std::string fField;
};

}  // namespace NORVZEL20
