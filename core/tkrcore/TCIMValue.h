// The tagged CIM value: null, a scalar of one CIM type, or an array.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "tkrcore/TCIMDateTime.h"

namespace NORVTKR20 {

class TCIMReference;

class TCIMValue {
public:
    // The CIM type tag. Date-time is 14; the report logic tests no other.
    class TCIMType {
    public:
        enum ECIMType {
            eBoolean = 0,
            eUint8 = 1,
            eSint8 = 2,
            eUint16 = 3,
            eSint16 = 4,
            eUint32 = 5,
            eSint32 = 6,
            eUint64 = 7,
            eSint64 = 8,
            eReal32 = 9,
            eReal64 = 10,
            eChar16 = 11,
            eString = 12,
            eReference = 13,
            eDateTime = 14,
            eUnknown = 15
        };

        TCIMType() : fType(eUnknown) {}
        TCIMType(ECIMType type) : fType(type) {}  // NOLINT: implicit by design
        operator ECIMType() const { return fType; }

        // The CIM-XML name of the type ("uint8", "string", "datetime"...).
        const char* GetName() const;
        // Looks up a CIM-XML type name; false when it names no CIM type.
        static bool FromName(const std::string& name, ECIMType& out);

    private:
        ECIMType fType;
    };

    TCIMValue();
    TCIMValue(const char* text);
    TCIMValue(const std::string& text);
    TCIMValue(unsigned int value);
    TCIMValue(unsigned short value);
    TCIMValue(const TCIMDateTime& value);
    explicit TCIMValue(const TCIMReference& value);
    explicit TCIMValue(TCIMReference&& value);
    TCIMValue(const TCIMValue& other);
    TCIMValue(TCIMValue&& other) noexcept;
    TCIMValue& operator=(const TCIMValue& other);
    TCIMValue& operator=(TCIMValue&& other) noexcept;
    ~TCIMValue();

    // Typed constructors for the repository and loaders.
    static TCIMValue Null(TCIMType::ECIMType type, bool isArray = false);
    static TCIMValue Boolean(bool value);
    static TCIMValue Unsigned(TCIMType::ECIMType type, std::uint64_t value);
    static TCIMValue Signed(TCIMType::ECIMType type, std::int64_t value);
    static TCIMValue Real(TCIMType::ECIMType type, double value);
    static TCIMValue Char16(const std::string& utf8Character);
    static TCIMValue Array(TCIMType::ECIMType elementType, std::vector<TCIMValue> elements);
    // Parses the text of a CIM-XML VALUE as the given type; throws
    // TTKRException(kTypeMismatch) or (kOutOfRange) when it does not fit.
    static TCIMValue FromText(TCIMType::ECIMType type, const std::string& text);
    // The number parsers behind FromText, without exceptions: a CIM integer
    // literal (decimal, 0x hex, binary with a trailing b; blanks around it
    // allowed) as sign and magnitude, and a real.
    static bool ParseIntegerText(const std::string& text, bool& negative, std::uint64_t& magnitude);
    static bool ParseRealText(const std::string& text, double& out);

    bool operator==(const TCIMValue& other) const;
    bool operator!=(const TCIMValue& other) const { return !(*this == other); }

    bool IsNull() const { return fIsNull; }
    bool IsArray() const { return fIsArray; }
    TCIMType GetType() const { return TCIMType(static_cast<TCIMType::ECIMType>(fType)); }

    // Conversions. Numbers convert between integer types when they fit, text
    // that spells a number converts to it; anything else throws
    // TTKRException (kNullValue, kTypeMismatch or kOutOfRange).
    operator bool() const;
    operator unsigned char() const;
    operator unsigned short() const;
    operator int() const;
    operator unsigned int() const;
    operator unsigned long() const;
    operator std::string() const;  // ToString(10); a null value gives ""
    operator TCIMDateTime() const;
    operator TCIMReference() const;
    operator std::vector<TCIMValue>&() const;  // throws kTypeMismatch unless an array
    // The path of a reference value, without a copy; null for anything else.
    const TCIMReference* GetReference() const;

    std::int64_t AsSigned() const;
    std::uint64_t AsUnsigned() const;
    double AsReal() const;

    // Text of the value. Integers use the radix (2 to 36); arrays join their
    // elements with ","; null gives "".
    std::string ToString(unsigned char radix) const;

    // The out-of-line part of a date-time, reference or array value.
    struct TPayload;

private:

    void ClearPayload();
    const TCIMValue& RequireScalar() const;

    std::uint8_t fType;
    bool fIsArray;
    bool fIsNull;
    union {
        std::uint64_t u;
        std::int64_t i;
        double d;
        bool b;
    } fNum;
    std::string fText;                    // string and char16 values
    std::unique_ptr<TPayload> fPayload;   // date-time, reference or array
};

}  // namespace NORVTKR20
