#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>
#include <ios>
#include <string>
#include <string_view>
#include <type_traits>
#include <vector>

#include "host/Export.h"

namespace NORVZEL20 {

class TCIMDateTime;
class TCIMReference;
class TEmbeddedObject;

/// A CIM-typed value, or null (DSP0004, 5.2 "Data types").
///
/// Cost: 16 bytes; copying allocates nothing. Numbers and text of up to 13 bytes are held inside the value; longer text, arrays,
/// references and embedded objects are immutable and shared by reference count.
/// Threads: different objects may be used concurrently, even if they share contents.
/// Errors: constructors that take text or several elements may throw std::bad_alloc; accessors and conversions throw
/// TZELException with kTypeMismatch (13) if the value is null or of a type that they do not accept.
class CIMDELTA_EXPORT alignas(8) TCIMValue {
  public:
    /// The type of a value; converts to and from the bare enumeration.
    class TCIMType {
      public:
        /// The code of an array type is that of its element type plus kArray.
        enum ECIMType : unsigned char {
            kNone = 0,  ///< the type of a null that has no type
            kBoolean = 1,
            kUint8 = 2,
            kSint8 = 3,
            kUint16 = 4,
            kSint16 = 5,
            kUint32 = 6,
            kSint32 = 7,
            kUint64 = 8,
            kSint64 = 9,
            kReal32 = 10,  ///< IEEE 754 binary32
            kReal64 = 11,  ///< IEEE 754 binary64
            kChar16 = 12,  ///< one UCS-2 code unit
            kString = 13,  ///< text in UTF-8, or an embedded object
            kDateTime = 14,
            kReference = 15,
            kArray = 16,  ///< added to an element type; never a type by itself
            kArrayBoolean = 17,
            kArrayUint8 = 18,
            kArraySint8 = 19,
            kArrayUint16 = 20,
            kArraySint16 = 21,
            kArrayUint32 = 22,
            kArraySint32 = 23,
            kArrayUint64 = 24,
            kArraySint64 = 25,
            kArrayReal32 = 26,
            kArrayReal64 = 27,
            kArrayChar16 = 28,
            kArrayString = 29,
            kArrayDateTime = 30,
            kArrayReference = 31
        };

        TCIMType(ECIMType type) noexcept : fType(type) {}
        operator ECIMType() const noexcept { return fType; }

        /// True for the codes above kArray.
        bool IsArray() const noexcept { return fType > kArray; }

        /// The type of one element; the type itself if it is no array.
        TCIMType GetElementType() const noexcept { return IsArray() ? static_cast<ECIMType>(fType - kArray) : fType; }

        /// The type of an array of this; the type itself if it is an array already.
        TCIMType GetArrayType() const noexcept { return IsArray() ? fType : static_cast<ECIMType>(fType + kArray); }

      private:
        ECIMType fType;
    };

    /// A null without a type.
    TCIMValue() noexcept;
    /// A null of the given type.
    static TCIMValue Null(TCIMType type) noexcept;
    /// A type is not a value. Use Null for a null of that type.
    TCIMValue(TCIMType::ECIMType type) = delete;

    TCIMValue(const TCIMValue& other) noexcept;
    TCIMValue(TCIMValue&& other) noexcept;
    TCIMValue& operator=(const TCIMValue& other) noexcept;
    TCIMValue& operator=(TCIMValue&& other) noexcept;
    ~TCIMValue();

    TCIMValue(bool value) noexcept;
    TCIMValue(unsigned char value) noexcept;        ///< uint8
    TCIMValue(signed char value) noexcept;          ///< sint8
    TCIMValue(unsigned short value) noexcept;       ///< uint16
    TCIMValue(short value) noexcept;                ///< sint16
    TCIMValue(unsigned int value) noexcept;         ///< uint32
    TCIMValue(int value) noexcept;                  ///< sint32
    TCIMValue(unsigned long value) noexcept;        ///< uint64
    TCIMValue(long value) noexcept;                 ///< sint64
    TCIMValue(unsigned long long value) noexcept;   ///< uint64
    TCIMValue(long long value) noexcept;            ///< sint64
    TCIMValue(float value) noexcept;                ///< real32
    TCIMValue(double value) noexcept;               ///< real64
    TCIMValue(char16_t value) noexcept;             ///< char16
    TCIMValue(const std::string& text);             ///< string; bytes are taken as they are, NUL included
    TCIMValue(const char* text);                    ///< string, up to the first NUL; must not be null
    TCIMValue(const TCIMDateTime& value) noexcept;  ///< datetime
    TCIMValue(TCIMReference& path);                 ///< reference; later changes of `path` do not matter
    TCIMValue(const TCIMReference& path);           ///< reference
    /// A string that is an embedded instance or class (DSP0004, 5.6.3.15 "EmbeddedObject"). Null gives a null string.
    TCIMValue(boost::shared_ptr<const TEmbeddedObject> object);

    /// An array of the first `count` of `elements`, or of all of them if there are fewer. `type` is the array's type or that of an
    /// element. Each element must be null or have the element type. An empty array is not null.
    /// Errors: kTypeMismatch (13) for an element of another type and for a type that has no arrays.
    TCIMValue(TCIMType type, unsigned int count, const std::vector<TCIMValue>& elements);

    /// A string of the given bytes, without a std::string in between.
    static TCIMValue FromText(std::string_view text);

    TCIMType GetType() const noexcept;
    bool IsNull() const noexcept;

    /// True if both are null, of any types, or have the same type and equal values.
    ///
    /// Text compares byte for byte; reals by value, with NaN equal to NaN and 0 to -0; datetimes as in TCIMDateTime; references by
    /// path text; embedded objects by structure; arrays element by element. If the left operand is a bag (see AsBag), the order of
    /// the elements does not matter. Linear; for bags n log n.
    bool operator==(const TCIMValue& other) const;
    bool operator!=(const TCIMValue& other) const { return !(*this == other); }

    /// The value of any integer between 0 and 65535. Errors: kTypeMismatch (13) for everything else, null included.
    operator unsigned short() const;
    /// The path of a reference. Errors: kTypeMismatch (13) for everything else, null included.
    operator TCIMReference() const;

    /// The accessors convert nothing. Errors: kTypeMismatch (13) for a null and for any type but their own.
    bool GetBoolean() const;
    std::uint64_t GetUnsigned() const;  ///< uint8 to uint64
    std::int64_t GetSigned() const;     ///< sint8 to sint64
    double GetReal() const;             ///< real32 and real64
    char16_t GetChar16() const;
    std::string_view GetString() const;  ///< string without an embedded object; valid until this value changes
    TCIMDateTime GetDateTime() const;

    /// The embedded object of a string; null if the value is plain text or a null. Errors: kTypeMismatch (13) for other types.
    boost::shared_ptr<const TEmbeddedObject> GetEmbeddedObject() const;

    /// The elements of an array. Valid until this value changes. Errors: kTypeMismatch (13) for everything else, null included.
    const std::vector<TCIMValue>& GetElements() const;

    /// The same array as a bag (qualifier ArrayType "Bag"): as the left operand of a comparison it is equal to every array with the
    /// same elements in any order. A null, or a value that is no array, comes back unchanged. Texts do not show the mark.
    TCIMValue AsBag() const;
    bool IsBag() const noexcept;

    /// The value for people and reports: text unquoted, numbers in decimal (reals in the shortest text that reads back the same),
    /// TRUE and FALSE, datetimes in their 25 characters, references as TCIMReference::ToText, embedded objects as CIM-XML, arrays
    /// as {a, b} with text quoted, null as NULL. Values that differ only in type may have the same text.
    std::string ToText() const;

    /// Appends the value in the form that it has in a path (see TCIMReference::GetPath).
    void AppendKeyText(std::string& out) const;

    /// Whether both values, as keys of one class, name the same instance: both are null, of any types, or they have the same type
    /// and the same key text. Except for embedded objects and arrays, this is equality by value, and no text is made. An embedded
    /// object is the same key as plain text that reads like its key text: a path cannot show the difference.
    bool IsSameKey(const TCIMValue& other) const;
    /// The same for values that are the same key.
    std::size_t KeyHash() const;

    /// Equal values of the same type have the same hash, except bags: their hash depends on the order of the elements.
    std::size_t Hash() const;

  private:
    friend class TCIMReference;
    friend class TValueAccess;

    /// How a key's text spells what can be written in several ways: in one way, or as it was written.
    enum class EKeyForm : unsigned char { kCanonical, kWritten };

    void AppendKey(std::string& out, EKeyForm form) const;
    void AppendKeyElements(std::string& out, EKeyForm form) const;
    /// Whether equality by value is not the relation of key texts.
    bool IsKeyByText() const noexcept;

    TCIMValue(TCIMType::ECIMType type, unsigned char form) noexcept;
    bool IsShared() const noexcept;

    TCIMType::ECIMType fType;
    unsigned char fForm;
    unsigned char fBytes[14];  // the contents; their layout depends on fForm
};

/// A value is not written to a stream: that would convert it to a number, which throws for most values. Write its ToText.
template <class TStream, class TValue,
          class = std::enable_if_t<std::conjunction_v<std::is_same<TValue, TCIMValue>,
                                                      std::is_base_of<std::ios_base, std::remove_reference_t<TStream>>>>>
TStream&& operator<<(TStream&& stream, const TValue& value) = delete;

}  // namespace NORVZEL20
