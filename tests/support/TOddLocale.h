#pragma once

#include <algorithm>
#include <locale>
#include <string>

namespace NORVZEL20 {

/// The process's locale is an odd one while this object lives: thousands are separated by a comma, and a semicolon is white space.
class TOddLocale {
  public:
    TOddLocale() : fFormer(std::locale::global(Make())) {}
    TOddLocale(const TOddLocale&) = delete;
    TOddLocale& operator=(const TOddLocale&) = delete;
    ~TOddLocale() { std::locale::global(fFormer); }

    static std::locale Make() { return std::locale(std::locale(std::locale::classic(), new TGrouping), new TSpaces); }

  private:
    struct TGrouping : std::numpunct<char> {
        char do_thousands_sep() const override { return ','; }
        std::string do_grouping() const override { return "\3"; }
    };

    struct TSpaces : std::ctype<char> {
        TSpaces() : std::ctype<char>(fMasks)
        {
            std::copy(classic_table(), classic_table() + table_size, fMasks);
            fMasks[static_cast<unsigned char>(';')] |= space;
        }
        mask fMasks[table_size];
    };

    std::locale fFormer;
};

}  // namespace NORVZEL20
