#include "tests/embedded/cimxml/MutateXml.h"

#include <iterator>
#include <string_view>

namespace NORVZEL20 {

namespace {

constexpr std::string_view kParts[] = {"<",
                                       ">",
                                       "&",
                                       "/",
                                       "=",
                                       "\"",
                                       "'",
                                       "-",
                                       "--",
                                       "]",
                                       "]]",
                                       "]]>",
                                       " ",
                                       "\t",
                                       "\n",
                                       "\r",
                                       "\r\n",
                                       "/>",
                                       "</",
                                       "<a>",
                                       "</a>",
                                       "<a/>",
                                       "<VALUE/>",
                                       "<VALUE>",
                                       "</VALUE>",
                                       "</VALUE >",
                                       "</VALUE\r\n>",
                                       "&lt;",
                                       "&amp;",
                                       "&quot;",
                                       "&apos;",
                                       "&gt;",
                                       "&foo;",
                                       "&#10;",
                                       "&#13;",
                                       "&#x41;",
                                       "&#0;",
                                       "&#9;",
                                       "&#xD800;",
                                       "&#x110000;",
                                       "&#x10FFFF;",
                                       "&#xFFFE;",
                                       "&#000065;",
                                       "<!",
                                       "<!--",
                                       "-->",
                                       "<!-- c -->",
                                       "<!---->",
                                       "<!-- a--b -->",
                                       "<!-- \xC3\xBC\r\n -->",
                                       "<![CDATA[",
                                       "<![CDATA[a<b]]>",
                                       "<?",
                                       "<?p i?>",
                                       "<?xml version=\"1.0\"?>",
                                       "<!DOCTYPE a>",
                                       "<!DOCTYPE a [<!ENTITY e '<b>&#60;'>]>",
                                       "&e;",
                                       " x=\"1\"",
                                       " x='<'",
                                       " x='>'",
                                       " x='>' y='&gt;'",
                                       " x = '&lt;\t\n'",
                                       " x=\"1\" x=\"1\"",
                                       " \xC3\xBC='1'",
                                       "\x01",
                                       "\x7F",
                                       "\xC3\xBC",
                                       "\xE2\x82\xAC",
                                       "\xF0\x9F\x98\x80",
                                       "\xEF\xBB\xBF",
                                       "\xEF\xBF\xBE",
                                       "\xED\xA0\x80",
                                       "\xC0\x80",
                                       "\xF4\x90\x80\x80",
                                       "\xFF",
                                       "\x80",
                                       "\xC3"};

std::string_view PickPart(std::mt19937& random)
{
    static constexpr std::string_view kNul("\0", 1);
    const std::size_t number = random() % (std::size(kParts) + 1);
    return number < std::size(kParts) ? kParts[number] : kNul;
}

void MutateOnce(std::string& document, std::mt19937& random)
{
    const std::size_t at = random() % (document.size() + 1);
    switch (random() % 5) {
    case 0:
    case 1:
        document.insert(at, PickPart(random));
        return;
    case 2:
        document.erase(at, 1 + random() % 4);
        return;
    case 3:
        document.replace(at, 1, 1, static_cast<char>(random() % 256));
        return;
    default: {
        const std::string_view part = PickPart(random);
        document.replace(at, part.size(), part);
    }
    }
}

}  // namespace

std::string MutateXml(std::string document, std::mt19937& random)
{
    for (std::size_t changes = random() % 4; changes > 0; --changes) {
        MutateOnce(document, random);
    }
    if (random() % 20 == 0) {
        document.resize(random() % (document.size() + 1));
    }
    return document;
}

}  // namespace NORVZEL20
