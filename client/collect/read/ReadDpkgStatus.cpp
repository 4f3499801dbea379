// dpkg's list of packages. A paragraph is a package, a blank line ends it:
//
//   Package: openssh-server
//   Status: install ok installed
//   Architecture: amd64
//   Source: openssh
//   Version: 1:9.2p1-2+deb12u10
//   Description: secure shell (SSH) server
//    More of the description: a line that begins with a blank continues the field above it.
//
// The three words of Status are what the administrator wants, whether something is broken, and how far the package has come.
#include "client/collect/read/ReadDpkgStatus.h"

#include <array>

#include "client/collect/read/TTextLines.h"
#include "client/collect/read/TextPieces.h"

namespace NORVZEL20 {

namespace {

struct TDpkgParagraph {
    std::size_t line = 0;  ///< of its beginning; 0: it has none yet
    std::string_view name;
    std::string_view status;
    std::string_view architecture;
    std::string_view source;
    std::string_view version;
};

struct TDpkgField {
    std::string_view name;
    std::string_view TDpkgParagraph::*value;
};

constexpr std::array<TDpkgField, 5> kDpkgFields = {{
    {"Package", &TDpkgParagraph::name},
    {"Status", &TDpkgParagraph::status},
    {"Architecture", &TDpkgParagraph::architecture},
    {"Source", &TDpkgParagraph::source},
    {"Version", &TDpkgParagraph::version},
}};

void TakeField(TDpkgParagraph& paragraph, std::string_view line)
{
    const std::size_t colon = line.find(':');
    for (const TDpkgField& field : kDpkgFields) {
        if (line.substr(0, colon) == field.name) {
            paragraph.*field.value = Trimmed(line.substr(colon + 1));
        }
    }
}

void AddPackage(std::vector<TFacts>& packages, const TDpkgParagraph& paragraph, TReadFaults& faults)
{
    const std::vector<std::string_view> status = SplitAtBlanks(paragraph.status);
    if (paragraph.name.empty() || status.size() != 3) {
        faults.Add(paragraph.line, paragraph.name.empty() ? "found a package without a name, expected the field Package"
                                                          : "found the status " + Quoted(paragraph.status) + " of " +
                                                                std::string(paragraph.name) + ", expected three words");
        return;
    }
    if (status[2] == "not-installed") {
        return;
    }
    if (paragraph.version.empty() || paragraph.architecture.empty()) {
        faults.Add(paragraph.line, "found no version or no architecture of " + std::string(paragraph.name) + ", expected both");
        return;
    }
    // "e2fsprogs (1.47.0-2)" if it was built anew from the source of that version.
    const std::string_view source = paragraph.source.substr(0, paragraph.source.find(' '));
    packages.push_back(TFacts("KALMO_Package")
                           .Key("Name", paragraph.name)
                           .Key("Architecture", paragraph.architecture)
                           .Key("Manager", "dpkg")
                           .Text("Version", paragraph.version)
                           .Text("State", status[1] == "ok" ? std::string(status[2])
                                                            : std::string(status[2]) + " (" + std::string(status[1]) + ")")
                           .Text("Selection", status[0])
                           .Text("Source", source == paragraph.name ? std::string_view() : source));
}

}  // namespace

std::vector<TFacts> ReadDpkgStatus(std::string_view text, TReadFaults& faults)
{
    std::vector<TFacts> packages;
    TDpkgParagraph paragraph;
    TTextLines lines(text);
    while (lines.Next()) {
        const std::string_view line = lines.GetLine();
        if (Trimmed(line).empty()) {
            if (paragraph.line > 0) {
                AddPackage(packages, paragraph, faults);
            }
            paragraph = TDpkgParagraph();
            continue;
        }
        if (paragraph.line == 0) {
            paragraph.line = lines.GetNumber();
        }
        if (line[0] == ' ' || line[0] == '\t') {
            continue;
        }
        if (line.find(':') == std::string_view::npos) {
            faults.Add(lines.GetNumber(), "found " + Quoted(line) + ", expected a field and its value");
            continue;
        }
        TakeField(paragraph, line);
    }
    if (paragraph.line > 0 && EndsWith(text, "\n")) {
        AddPackage(packages, paragraph, faults);
    } else if (paragraph.line > 0) {
        faults.Add(lines.GetNumber(), "found the end of the file, expected the rest of the line");
    }
    return packages;
}

}  // namespace NORVZEL20
