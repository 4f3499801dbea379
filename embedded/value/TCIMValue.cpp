// A value takes 16 bytes, so an instance can hold its values in a row:
//
//     byte         0     1     2                 3            8
//     number       type  form  -                              64 bits
//     datetime     type  form  offset, unknown fields, kind   microseconds
//     short text   type  form  length            up to 13 bytes of text
//     text in run  type  form  length, offset                 pointer to a TTextRun, which begins with TCounted
//     others       type  form  -                              pointer to a block that begins with TCounted
//
// A signed integer is sign-extended and a real32 is held as a double. Longer text, arrays, paths and embedded objects are in
// blocks that never change (a run only gets further texts), so a copy is 16 bytes and one more use of the block. A moved-from value
// is a null of its type. The form says how to read the rest; TValueAccess lists the forms and has the unchecked access to them.

#include "host/TCIMValue.h"

#include <algorithm>
#include <limits>

#include "embedded/value/TCountedBlocks.h"
#include "embedded/value/TTypeKind.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/TValueText.h"
#include "embedded/value/TValueXml.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

using TAccess = TValueAccess;

/// Accessors fail in this way only.
[[noreturn]] void RefuseType()
{
    throw TZELException(TZELStatusCode::kTypeMismatch);
}

/// Text is quoted inside of an array, because it may contain the separators.
void AppendElement(std::string& out, const TCIMValue& element)
{
    if (TAccess::IsText(element)) {
        TValueText::AppendQuoted(out, TAccess::GetText(element), '"');
    } else {
        out += element.ToText();
    }
}

void AppendElements(std::string& out, const std::vector<TCIMValue>& elements)
{
    out += '{';
    for (std::size_t i = 0; i < elements.size(); ++i) {
        out += i == 0 ? "" : ", ";
        AppendElement(out, elements[i]);
    }
    out += '}';
}

}  // namespace

TCIMValue::TCIMValue(TCIMType::ECIMType type, unsigned char form) noexcept : fType(type), fForm(form), fBytes() {}

TCIMValue::TCIMValue() noexcept : TCIMValue(TCIMType::kNone, TAccess::kNull) {}

TCIMValue TCIMValue::Null(TCIMType type) noexcept
{
    return TCIMValue(type, TAccess::kNull);
}

bool TCIMValue::IsShared() const noexcept
{
    return fForm >= TAccess::kSharedText;
}

TCIMValue::TCIMValue(const TCIMValue& other) noexcept : fType(other.fType), fForm(other.fForm)
{
    std::memcpy(fBytes, other.fBytes, sizeof fBytes);
    if (IsShared()) {
        // The empty path has no block.
        if (const TCounted* const block = TAccess::GetBlock(*this)) {
            block->Acquire();
        }
    }
}

/// The use of the block moves along with the bytes, so the count stays as it is.
TCIMValue::TCIMValue(TCIMValue&& other) noexcept : fType(other.fType), fForm(other.fForm)
{
    std::memcpy(fBytes, other.fBytes, sizeof fBytes);
    other.fForm = TAccess::kNull;
}

TCIMValue& TCIMValue::operator=(const TCIMValue& other) noexcept
{
    // The copy is made first, so a value may be assigned to itself or to an element of itself.
    return *this = TCIMValue(other);
}

TCIMValue& TCIMValue::operator=(TCIMValue&& other) noexcept
{
    if (this != &other) {
        if (IsShared()) {
            TAccess::DropBlock(*this);
        }
        fType = other.fType;
        fForm = other.fForm;
        std::memcpy(fBytes, other.fBytes, sizeof fBytes);
        other.fForm = TAccess::kNull;
    }
    return *this;
}

TCIMValue::~TCIMValue()
{
    if (IsShared()) {
        TAccess::DropBlock(*this);
    }
}

TCIMValue::TCIMValue(bool value) noexcept : TCIMValue(TAccess::FromBits(TCIMType::kBoolean, value ? 1 : 0)) {}
TCIMValue::TCIMValue(unsigned char value) noexcept : TCIMValue(TAccess::FromBits(TCIMType::kUint8, value)) {}
TCIMValue::TCIMValue(signed char value) noexcept : TCIMValue(TAccess::FromBits(TCIMType::kSint8, static_cast<std::uint64_t>(value)))
{}
TCIMValue::TCIMValue(unsigned short value) noexcept : TCIMValue(TAccess::FromBits(TCIMType::kUint16, value)) {}
TCIMValue::TCIMValue(short value) noexcept : TCIMValue(TAccess::FromBits(TCIMType::kSint16, static_cast<std::uint64_t>(value))) {}
TCIMValue::TCIMValue(unsigned int value) noexcept : TCIMValue(TAccess::FromBits(TCIMType::kUint32, value)) {}
TCIMValue::TCIMValue(int value) noexcept : TCIMValue(TAccess::FromBits(TCIMType::kSint32, static_cast<std::uint64_t>(value))) {}
TCIMValue::TCIMValue(unsigned long value) noexcept : TCIMValue(TAccess::FromBits(TCIMType::kUint64, value)) {}
TCIMValue::TCIMValue(long value) noexcept : TCIMValue(TAccess::FromBits(TCIMType::kSint64, static_cast<std::uint64_t>(value))) {}
TCIMValue::TCIMValue(unsigned long long value) noexcept : TCIMValue(TAccess::FromBits(TCIMType::kUint64, value)) {}
TCIMValue::TCIMValue(long long value) noexcept : TCIMValue(TAccess::FromBits(TCIMType::kSint64, static_cast<std::uint64_t>(value)))
{}
TCIMValue::TCIMValue(float value) noexcept : TCIMValue(TAccess::FromReal(TCIMType::kReal32, static_cast<double>(value))) {}
TCIMValue::TCIMValue(double value) noexcept : TCIMValue(TAccess::FromReal(TCIMType::kReal64, value)) {}
TCIMValue::TCIMValue(char16_t value) noexcept : TCIMValue(TAccess::FromBits(TCIMType::kChar16, value)) {}
TCIMValue::TCIMValue(const std::string& text) : TCIMValue(FromText(text)) {}
TCIMValue::TCIMValue(const char* text) : TCIMValue(FromText(text)) {}
TCIMValue::TCIMValue(TCIMReference& path) : TCIMValue(static_cast<const TCIMReference&>(path)) {}

TCIMValue::TCIMValue(const TCIMDateTime& value) noexcept : TCIMValue(TCIMType::kDateTime, TAccess::kDateTime)
{
    TAccess::StoreDateTime(*this, value);
}

TCIMValue::TCIMValue(const TCIMReference& path) : TCIMValue(TCIMType::kReference, TAccess::kPath)
{
    TAccess::Store(*this, TAccess::AcquirePath(path));
}

TCIMValue::TCIMValue(boost::shared_ptr<const TEmbeddedObject> object) : TCIMValue(TCIMType::kString, TAccess::kNull)
{
    if (object) {
        TAccess::Store(*this, static_cast<const TCounted*>(new TCountedObject(std::move(object))));
        fForm = TAccess::kObject;
    }
}

TCIMValue::TCIMValue(TCIMType type, unsigned int count, const std::vector<TCIMValue>& elements)
    : TCIMValue(type.GetArrayType(), TAccess::kNull)
{
    const TCIMType elementType = type.GetElementType();
    if (elementType == TCIMType::kNone || elementType > TCIMType::kReference) {
        RefuseType();
    }
    std::vector<TCIMValue> taken(elements.begin(),
                                 elements.begin() + static_cast<std::ptrdiff_t>(std::min<std::size_t>(count, elements.size())));
    for (TCIMValue& element : taken) {
        if (element.IsNull()) {
            element = Null(elementType);
        } else if (element.fType != elementType) {
            RefuseType();
        }
    }
    // The form is set last: if the allocation fails, this is still a null, which its destructor leaves alone.
    TAccess::Store(*this, static_cast<const TCounted*>(new TCountedArray(std::move(taken))));
    fForm = TAccess::kArray;
}

TCIMValue TCIMValue::FromText(std::string_view text)
{
    if (text.size() <= TAccess::kShortTextSize) {
        TCIMValue value(TCIMType::kString, TAccess::kShortText);
        TAccess::StoreText(value, text);
        return value;
    }
    // The one step that may fail comes first. The value takes over the one use that the new block has.
    const TCounted* const block = TSharedText::CreateRaw(text);
    TCIMValue value(TCIMType::kString, TAccess::kSharedText);
    TAccess::Store(value, block);
    return value;
}

TCIMValue::TCIMType TCIMValue::GetType() const noexcept
{
    return fType;
}

bool TCIMValue::IsNull() const noexcept
{
    return fForm == TAccess::kNull;
}

TCIMValue::operator unsigned short() const
{
    const bool isInteger = !IsNull() && TTypeKind::IsInteger(fType);
    // A negative number is sign-extended, so its bits exceed the range as well.
    if (!isInteger || TAccess::GetBits(*this) > std::numeric_limits<unsigned short>::max()) {
        RefuseType();
    }
    return static_cast<unsigned short>(TAccess::GetBits(*this));
}

TCIMValue::operator TCIMReference() const
{
    if (fForm != TAccess::kPath) {
        RefuseType();
    }
    return TAccess::GetPath(*this);
}

bool TCIMValue::GetBoolean() const
{
    if (IsNull() || fType != TCIMType::kBoolean) {
        RefuseType();
    }
    return TAccess::GetBits(*this) != 0;
}

std::uint64_t TCIMValue::GetUnsigned() const
{
    if (IsNull() || !TTypeKind::IsUnsigned(fType)) {
        RefuseType();
    }
    return TAccess::GetBits(*this);
}

std::int64_t TCIMValue::GetSigned() const
{
    if (IsNull() || !TTypeKind::IsSigned(fType)) {
        RefuseType();
    }
    return static_cast<std::int64_t>(TAccess::GetBits(*this));
}

double TCIMValue::GetReal() const
{
    if (IsNull() || !TTypeKind::IsReal(fType)) {
        RefuseType();
    }
    return TAccess::GetReal(*this);
}

char16_t TCIMValue::GetChar16() const
{
    if (IsNull() || fType != TCIMType::kChar16) {
        RefuseType();
    }
    return static_cast<char16_t>(TAccess::GetBits(*this));
}

std::string_view TCIMValue::GetString() const
{
    if (!TAccess::IsText(*this)) {
        RefuseType();
    }
    return TAccess::GetText(*this);
}

TCIMDateTime TCIMValue::GetDateTime() const
{
    if (fForm != TAccess::kDateTime) {
        RefuseType();
    }
    return TAccess::LoadDateTime(*this);
}

boost::shared_ptr<const TEmbeddedObject> TCIMValue::GetEmbeddedObject() const
{
    if (fType != TCIMType::kString) {
        RefuseType();
    }
    return fForm == TAccess::kObject ? static_cast<const TCountedObject*>(TAccess::GetBlock(*this))->object : nullptr;
}

const std::vector<TCIMValue>& TCIMValue::GetElements() const
{
    if (fForm != TAccess::kArray && fForm != TAccess::kBag) {
        RefuseType();
    }
    return static_cast<const TCountedArray*>(TAccess::GetBlock(*this))->elements;
}

TCIMValue TCIMValue::AsBag() const
{
    TCIMValue result(*this);
    if (fForm == TAccess::kArray) {
        // The block is shared; only the form differs.
        result.fForm = TAccess::kBag;
    }
    return result;
}

bool TCIMValue::IsBag() const noexcept
{
    return fForm == TAccess::kBag;
}

std::string TCIMValue::ToText() const
{
    std::string text;
    switch (fForm) {
    case TAccess::kNull:
        text = "NULL";
        break;
    case TAccess::kObject:
        text = GetEmbeddedObject()->ToText();
        break;
    case TAccess::kArray:
    case TAccess::kBag:
        AppendElements(text, GetElements());
        break;
    case TAccess::kPath:
        text = TAccess::GetPath(*this).ToText();
        break;
    default:
        TValueText::AppendPlain(text, *this);
        break;
    }
    return text;
}

void TCIMValue::AppendKeyText(std::string& out) const
{
    AppendKey(out, EKeyForm::kCanonical);
}

/// Different keys must have different texts, so text is quoted and escaped here, unlike in ToText. Equal keys must have equal
/// texts, so the canonical form has one spelling for each.
void TCIMValue::AppendKey(std::string& out, EKeyForm form) const
{
    const bool isCanonical = form == EKeyForm::kCanonical;
    switch (fForm) {
    case TAccess::kShortText:
    case TAccess::kSharedText:
    case TAccess::kRunText:
        TValueText::AppendQuoted(out, TAccess::GetText(*this), '"');
        break;
    case TAccess::kNumber:
        if (fType == TCIMType::kChar16) {
            TValueText::AppendQuoted(out, ToText(), '\'');
        } else if (TTypeKind::IsReal(fType) && TAccess::GetReal(*this) == 0) {
            out += '0';  // also -0
        } else {
            TValueText::AppendPlain(out, *this);
        }
        break;
    case TAccess::kPath:
        TValueText::AppendQuotedBy(out, '"', [&](std::string& text) { TAccess::GetPath(*this).AppendText(text, form); });
        break;
    case TAccess::kDateTime:
        TValueText::AppendQuoted(out, (isCanonical ? GetDateTime().GetCanonical() : GetDateTime()).ToText(), '"');
        break;
    case TAccess::kObject:
        TValueText::AppendQuoted(out, isCanonical ? GetEmbeddedObject()->GetKeyText() : ToText(), '"');
        break;
    case TAccess::kArray:
    case TAccess::kBag:
        AppendKeyElements(out, form);
        break;
    default:
        out += "NULL";
        break;
    }
}

void TCIMValue::AppendKeyElements(std::string& out, EKeyForm form) const
{
    std::vector<std::string> texts;
    texts.reserve(GetElements().size());
    for (const TCIMValue& element : GetElements()) {
        element.AppendKey(texts.emplace_back(), form);
    }
    if (IsBag() && form == EKeyForm::kCanonical) {
        std::sort(texts.begin(), texts.end());
    }
    out += '{';
    for (std::size_t i = 0; i < texts.size(); ++i) {
        out.append(i == 0 ? "" : ", ").append(texts[i]);
    }
    out += '}';
}

}  // namespace NORVZEL20
