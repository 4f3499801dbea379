#pragma once

#include <string>
#include <vector>

#include "tests/client/Documents.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {

/// Compares two documents that the test itself contains.
class TPairFixture : public TClientFixture {
  protected:
    /// The report of the comparison, or the messages; the documents are called "a" and "b", without the paths of their files.
    std::string Compare(const std::string& a, const std::string& b, const std::vector<std::string>& options = {})
    {
        const std::string first = Scratch("a.xml", a);
        const std::string second = Scratch("b.xml", b);
        std::vector<std::string> arguments{"compare", "--detail", first, second};
        arguments.insert(arguments.end(), options.begin(), options.end());
        Run(arguments);
        return Named(fStatus == 2 ? fErr : fOut, first, second);
    }

    static std::string Named(const std::string& text, const std::string& first, const std::string& second)
    {
        const std::string directory = first.substr(0, first.rfind('/') + 1);
        const auto label = [&](const std::string& path) {
            return path.substr(directory.size(), path.size() - directory.size() - 4);
        };
        return Shorten(Shorten(Shorten(text, directory, ""), label(first), "a"), label(second), "b");
    }
};

}  // namespace NORVZEL20
