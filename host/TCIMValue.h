#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace NORVZEL20 {

class TCIMDateTime;
class TCIMReference;
class TEmbeddedObject;

/// A CIM-typed value, or null (DSP0004, 5.2 "Data types").
///
/// Cost: 16 bytes; copying allocates nothing (numbers and text of up to 13 bytes are held inside, longer text, arrays,
/// references and embedded objects are immutable and shared by reference count).
/// Threads: distinct objects may be used by distinct threads at once, also when they share contents.
/// Errors: constructors that hold text or several elements may throw std::bad_alloc; accessors and conversions throw
/// TZELException with status 13 (type mismatch) where the value is null or of a type they do not accept.
class alignas(8) TCIMValue {
  public:
    /// The type of a value; converts to and from the bare enumeration.
    class TCIMType {
      public:
        /// The code of an array type is that of its element type plus kArray.
        enum ECIMType : unsigned char {
            kNone = 0,  ///< no type: a null of which nothing more is known
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
            kString = 13,  ///< UTF-8; also carries embedded objects
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

        /// The type of one element; the type itself where it is no array.
        TCIMType GetElementType() const noexcept { return IsArray() ? ECIMType(fType - kArray) : fType; }

        /// The type of an array of this; the type itself where it is an array already.
        TCIMType GetArrayType() const noexcept { return IsArray() ? fType : ECIMType(fType + kArray); }

      private:
        ECIMType fType;
    };

    /// A null without a type.
    TCIMValue() noexcept;
    /// A null of the given type.
    static TCIMValue Null(TCIMType type) noexcept;
    /// A type is no value: Null makes a null of it.
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
    TCIMValue(TCIMReference& path);                 ///< reference; later changes of `path` do not show
    TCIMValue(const TCIMReference& path);           ///< reference
    /// A string that is an embedded instance or class (DSP0004, 5.6.3.15 "EmbeddedObject"). Null gives a null string.
    TCIMValue(boost::shared_ptr<const TEmbeddedObject> object);

    /// An array of the first `count` of `elements`, all of them where there are fewer. `type` is the array's type or that of
    /// an element. An element may be null; any other must have the element type, else status 13. An empty array is not null.
    TCIMValue(TCIMType type, unsigned int count, const std::vector<TCIMValue>& elements);

    /// A string of the given bytes, without a std::string in between.
    static TCIMValue FromText(std::string_view text);

    TCIMType GetType() const noexcept;
    bool IsNull() const noexcept;

    /// Whether both are null (of whatever type), or of the same type and equal in value.
    ///
    /// Text byte for byte; reals by value, NaN equal to NaN and 0 to -0; datetimes as TCIMDateTime says; references by path text;
    /// embedded objects by structure; arrays element by element in order, except that an array marked as a bag (see
    /// AsBag) compares as a multiset when it is the left operand. Linear, for bags n log n.
    bool operator==(const TCIMValue& other) const;
    bool operator!=(const TCIMValue& other) const { return !(*this == other); }

    /// Any integer value between 0 and 65535; everything else, null included, throws status 13.
    operator unsigned short() const;
    /// The path of a reference value; everything else, null included, throws status 13.
    operator TCIMReference() const;

    /// Exact accessors: each accepts its own type alone, else status 13.
    bool GetBoolean() const;
    std::uint64_t GetUnsigned() const;  ///< uint8 to uint64
    std::int64_t GetSigned() const;     ///< sint8 to sint64
    double GetReal() const;             ///< real32 (exactly) and real64
    char16_t GetChar16() const;
    std::string_view GetString() const;  ///< string without an embedded object; valid while this value lives unchanged
    TCIMDateTime GetDateTime() const;

    /// The embedded object of a string value, or null where it holds plain text or is null. Status 13 for other types.
    boost::shared_ptr<const TEmbeddedObject> GetEmbeddedObject() const;

    /// The elements of an array, valid while this value lives unchanged. Status 13 for anything else, null included.
    const std::vector<TCIMValue>& GetElements() const;

    /// The same array, marked to compare as a multiset where it is the left operand (the qualifier ArrayType "Bag").
    /// Values that are no arrays, and nulls, come back as they are. The mark does not show in texts.
    TCIMValue AsBag() const;
    bool IsBag() const noexcept;

    /// The value for people and reports: text unquoted, numbers in decimal (reals in their shortest exact form), TRUE and FALSE,
    /// datetimes in their 25 characters, references as paths, embedded objects as CIM-XML, arrays as {a, b} with text quoted,
    /// null as NULL. Does not tell apart what differs in type alone.
    std::string ToText() const;

    /// Appends the value as a key binding of a path carries it (see TCIMReference::GetPath).
    void AppendKeyText(std::string& out) const;

    /// A hash that agrees with operator== for values of one type, except that a bag hashes by order.
    std::size_t Hash() const;

  private:
    friend class TValueAccess;

    TCIMValue(TCIMType::ECIMType type, unsigned char form) noexcept;
    bool IsShared() const noexcept;

    TCIMType::ECIMType fType;
    unsigned char fForm;
    unsigned char fBytes[14];  // a number or a pointer from offset 6 on (offset 8 of the whole), or a length and short text
};

}  // namespace NORVZEL20
