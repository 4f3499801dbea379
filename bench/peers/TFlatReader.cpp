// Makes tables of text from a document: a class declaration opens a table, an instance is a row, a property of it a cell.
//
// It is written as one would write it for this purpose alone, with the usual containers and without tricks: it is the yardstick for
// what can be expected of a program that uses Expat. Handlers of Expat must not throw, so a fault stops the parser and is thrown
// when that has returned.

#include "bench/peers/TFlatReader.h"

#include <cstdio>
#include <cstring>
#include <memory>
#include <stdexcept>

namespace NORVZEL20 {
namespace {

constexpr int kPieceBytes = 64 * 1024;

std::string Attribute(const char** attributes, const char* name)
{
    for (; *attributes != nullptr; attributes += 2) {
        if (std::strcmp(attributes[0], name) == 0) {
            return attributes[1];
        }
    }
    return {};
}

}  // namespace

TFlatReader::TFlatReader(TFlatInventory& inventory, const std::string& path)
    : fInventory(inventory), fPath(path), fParser(XML_ParserCreate(nullptr))
{
    XML_SetUserData(fParser, this);
    XML_SetElementHandler(
        fParser,
        [](void* reader, const XML_Char* name, const XML_Char** attributes) {
            static_cast<TFlatReader*>(reader)->Start(name, attributes);
        },
        [](void* reader, const XML_Char* name) { static_cast<TFlatReader*>(reader)->End(name); });
    XML_SetCharacterDataHandler(fParser, [](void* reader, const XML_Char* text, int length) {
        auto* self = static_cast<TFlatReader*>(reader);
        if (self->fIsInValue) {
            self->fSlot->append(text, static_cast<std::size_t>(length));
        }
    });
}

TFlatReader::~TFlatReader()
{
    XML_ParserFree(fParser);
}

void TFlatReader::Refuse(const std::string& reason) const
{
    throw std::runtime_error(fPath + ": " + reason);
}

void TFlatReader::Read()
{
    const std::unique_ptr<std::FILE, int (*)(std::FILE*)> file(std::fopen(fPath.c_str(), "rb"), std::fclose);
    if (!file) {
        Refuse("cannot be opened");
    }
    bool isLast = false;
    while (!isLast) {
        void* piece = XML_GetBuffer(fParser, kPieceBytes);
        if (piece == nullptr) {
            throw std::bad_alloc();
        }
        const std::size_t length = std::fread(piece, 1, kPieceBytes, file.get());
        if (std::ferror(file.get()) != 0) {
            Refuse("cannot be read");
        }
        isLast = length < kPieceBytes;
        if (XML_ParseBuffer(fParser, static_cast<int>(length), isLast) != XML_STATUS_OK) {
            Refuse(fFault.empty() ? XML_ErrorString(XML_GetErrorCode(fParser)) : fFault);
        }
    }
}

void TFlatReader::Start(std::string_view element, const char** attributes)
{
    if (element == "PROPERTY") {
        if (fIsInInstance) {
            StartValue(Attribute(attributes, "NAME"));
        } else {
            fInventory.fClasses.back().properties.push_back(Attribute(attributes, "NAME"));
        }
    } else if (element == "VALUE") {
        fIsInValue = fSlot != nullptr;
    } else if (element == "INSTANCE") {
        StartInstance(Attribute(attributes, "CLASSNAME"));
    } else if (element == "QUALIFIER" && Attribute(attributes, "NAME") == "Key") {
        TFlatClass& type = fInventory.fClasses.back();
        type.keys.push_back(type.properties.size() - 1);
    } else if (element == "CLASS") {
        TFlatClass type;
        type.name = Attribute(attributes, "NAME");
        fClassNumbers.emplace(type.name, fInventory.fClasses.size());
        fInventory.fClasses.push_back(std::move(type));
    }
}

void TFlatReader::StartInstance(const std::string& className)
{
    const auto found = fClassNumbers.find(className);
    if (found == fClassNumbers.end()) {
        fFault = "an instance of " + className + " comes before its class";
        XML_StopParser(fParser, XML_FALSE);
        return;
    }
    TFlatRow row;
    row.classNumber = found->second;
    row.values.resize(fInventory.fClasses[row.classNumber].properties.size());
    fInventory.fRows.push_back(std::move(row));
    fIsInInstance = true;
    fNextProperty = 0;
}

void TFlatReader::StartValue(const std::string& property)
{
    TFlatRow& row = fInventory.fRows.back();
    const std::vector<std::string>& names = fInventory.fClasses[row.classNumber].properties;
    for (std::size_t tried = 0; tried < names.size(); ++tried) {
        const std::size_t place = (fNextProperty + tried) % names.size();
        if (names[place] == property) {
            fSlot = &row.values[place];
            fNextProperty = place + 1;
            return;
        }
    }
    fFault = "property " + property + " is not declared";
    XML_StopParser(fParser, XML_FALSE);
}

void TFlatReader::End(std::string_view element)
{
    if (element == "VALUE") {
        fIsInValue = false;
    } else if (element == "PROPERTY") {
        fSlot = nullptr;
    } else if (element == "INSTANCE") {
        fIsInInstance = false;
    }
}

}  // namespace NORVZEL20
