#include "tkrcore/TCIMValue.h"

#include <cctype>
#include <charconv>
#include <cmath>
#include <cstdlib>
#include <cstring>
#include <limits>

#include "tkrcore/TCIMReference.h"
#include "tkrcore/TTKRException.h"

namespace NORVTKR20 {

typedef TCIMValue::TCIMType::ECIMType ECIMType;
typedef TCIMValue::TCIMType TType;

// The heavier kinds live out of line so that the common value stays small;
// each kind allocates only what it holds.
struct TCIMValue::TPayload {
    virtual ~TPayload() {}
    virtual TPayload* Clone() const = 0;
};

namespace {

template <typename T>
struct THolder : TCIMValue::TPayload {
    explicit THolder(T item) : fItem(std::move(item)) {}
    TCIMValue::TPayload* Clone() const override { return new THolder(fItem); }
    T fItem;
};

template <typename T>
T& Item(const std::unique_ptr<TCIMValue::TPayload>& payload) {
    return static_cast<THolder<T>*>(payload.get())->fItem;
}

}  // namespace

namespace {

const char* const kTypeNames[] = {"boolean", "uint8",  "sint8",  "uint16", "sint16", "uint32",
                                  "sint32",  "uint64", "sint64", "real32", "real64", "char16",
                                  "string",  "reference", "datetime", "unknown"};

bool IsUnsignedType(int t) {
    return t == TType::eUint8 || t == TType::eUint16 || t == TType::eUint32 || t == TType::eUint64;
}
bool IsSignedType(int t) {
    return t == TType::eSint8 || t == TType::eSint16 || t == TType::eSint32 || t == TType::eSint64;
}
bool IsRealType(int t) { return t == TType::eReal32 || t == TType::eReal64; }
bool IsTextType(int t) { return t == TType::eString || t == TType::eChar16; }

std::uint64_t UnsignedMax(int t) {
    switch (t) {
        case TType::eUint8: return 0xFFu;
        case TType::eUint16: return 0xFFFFu;
        case TType::eUint32: return 0xFFFFFFFFu;
        default: return std::numeric_limits<std::uint64_t>::max();
    }
}

void SignedRange(int t, std::int64_t& lo, std::int64_t& hi) {
    switch (t) {
        case TType::eSint8: lo = -128; hi = 127; break;
        case TType::eSint16: lo = -32768; hi = 32767; break;
        case TType::eSint32: lo = std::numeric_limits<std::int32_t>::min(); hi = std::numeric_limits<std::int32_t>::max(); break;
        default: lo = std::numeric_limits<std::int64_t>::min(); hi = std::numeric_limits<std::int64_t>::max(); break;
    }
}

std::string Trim(const std::string& s) {
    size_t b = s.find_first_not_of(" \t\r\n");
    if (b == std::string::npos) return std::string();
    size_t e = s.find_last_not_of(" \t\r\n");
    return s.substr(b, e - b + 1);
}

// Parses a CIM integer literal: decimal, 0x hex, or binary with a trailing b.
bool ParseInteger(const std::string& text, bool& negative, std::uint64_t& magnitude) {
    std::string s = Trim(text);
    negative = false;
    if (s.empty()) return false;
    size_t pos = 0;
    if (s[0] == '+' || s[0] == '-') {
        negative = s[0] == '-';
        pos = 1;
    }
    int base = 10;
    size_t end = s.size();
    if (s.size() > pos + 2 && s[pos] == '0' && (s[pos + 1] == 'x' || s[pos + 1] == 'X')) {
        base = 16;
        pos += 2;
    } else if (s.size() > pos + 1 && (s.back() == 'b' || s.back() == 'B') &&
               s.find_first_not_of("01", pos) == s.size() - 1) {
        base = 2;
        end = s.size() - 1;
    }
    if (pos >= end) return false;
    auto res = std::from_chars(s.data() + pos, s.data() + end, magnitude, base);
    return res.ec == std::errc() && res.ptr == s.data() + end;
}

bool ParseReal(const std::string& text, double& out) {
    std::string s = Trim(text);
    if (s.empty()) return false;
    auto res = std::from_chars(s.data(), s.data() + s.size(), out);
    if (res.ec == std::errc() && res.ptr == s.data() + s.size()) return true;
    if (s[0] == '+') {
        res = std::from_chars(s.data() + 1, s.data() + s.size(), out);
        return res.ec == std::errc() && res.ptr == s.data() + s.size();
    }
    return false;
}

std::string FormatUnsigned(std::uint64_t v, unsigned radix) {
    if (radix < 2 || radix > 36) radix = 10;
    char buf[72];
    auto res = std::to_chars(buf, buf + sizeof buf, v, static_cast<int>(radix));
    return std::string(buf, res.ptr);
}

std::string FormatSigned(std::int64_t v, unsigned radix) {
    if (radix < 2 || radix > 36) radix = 10;
    char buf[72];
    auto res = std::to_chars(buf, buf + sizeof buf, v, static_cast<int>(radix));
    return std::string(buf, res.ptr);
}

std::string FormatReal(double v, bool single) {
    char buf[64];
    std::to_chars_result res = single ? std::to_chars(buf, buf + sizeof buf, static_cast<float>(v))
                                      : std::to_chars(buf, buf + sizeof buf, v);
    return std::string(buf, res.ptr);
}

[[noreturn]] void Fail(int status) { throw TTKRException(status); }

// One character of UTF-8: a lead byte and as many continuation bytes as it
// announces.
bool IsOneCharacter(const std::string& text) {
    if (text.empty()) return false;
    const unsigned char lead = static_cast<unsigned char>(text[0]);
    const size_t length = lead < 0x80 ? 1 : lead >= 0xF0 ? 4 : lead >= 0xE0 ? 3 : lead >= 0xC0 ? 2 : 0;
    if (length != text.size()) return false;
    for (size_t k = 1; k < length; ++k)
        if ((static_cast<unsigned char>(text[k]) & 0xC0) != 0x80) return false;
    return true;
}

}  // namespace

const char* TCIMValue::TCIMType::GetName() const {
    int t = static_cast<int>(fType);
    return (t >= 0 && t <= 15) ? kTypeNames[t] : "unknown";
}

bool TCIMValue::TCIMType::FromName(const std::string& name, ECIMType& out) {
    for (int t = 0; t < 15; ++t) {
        if (name == kTypeNames[t]) {
            out = static_cast<ECIMType>(t);
            return true;
        }
    }
    return false;
}

TCIMValue::TCIMValue() : fType(TType::eUnknown), fIsArray(false), fIsNull(true) { fNum.u = 0; }

TCIMValue::TCIMValue(const char* text) : TCIMValue(std::string(text ? text : "")) {}

TCIMValue::TCIMValue(const std::string& text) : fType(TType::eString), fIsArray(false), fIsNull(false), fText(text) {
    fNum.u = 0;
}

TCIMValue::TCIMValue(unsigned int value) : fType(TType::eUint32), fIsArray(false), fIsNull(false) { fNum.u = value; }

TCIMValue::TCIMValue(unsigned short value) : fType(TType::eUint16), fIsArray(false), fIsNull(false) { fNum.u = value; }

TCIMValue::TCIMValue(const TCIMDateTime& value)
    : fType(TType::eDateTime), fIsArray(false), fIsNull(false), fPayload(new THolder<TCIMDateTime>(value)) {
    fNum.u = 0;
}

TCIMValue::TCIMValue(const TCIMReference& value)
    : fType(TType::eReference), fIsArray(false), fIsNull(false), fPayload(new THolder<TCIMReference>(value)) {
    fNum.u = 0;
}

TCIMValue::TCIMValue(TCIMReference&& value)
    : fType(TType::eReference), fIsArray(false), fIsNull(false),
      fPayload(new THolder<TCIMReference>(std::move(value))) {
    fNum.u = 0;
}

TCIMValue::TCIMValue(const TCIMValue& o)
    : fType(o.fType), fIsArray(o.fIsArray), fIsNull(o.fIsNull), fNum(o.fNum), fText(o.fText),
      fPayload(o.fPayload ? o.fPayload->Clone() : nullptr) {}

TCIMValue::TCIMValue(TCIMValue&& o) noexcept
    : fType(o.fType), fIsArray(o.fIsArray), fIsNull(o.fIsNull), fNum(o.fNum), fText(std::move(o.fText)),
      fPayload(std::move(o.fPayload)) {}

TCIMValue& TCIMValue::operator=(const TCIMValue& o) {
    if (this != &o) {
        // Copy the payload first: `o` may live inside this value's payload.
        std::unique_ptr<TPayload> payload(o.fPayload ? o.fPayload->Clone() : nullptr);
        fType = o.fType;
        fIsArray = o.fIsArray;
        fIsNull = o.fIsNull;
        fNum = o.fNum;
        fText = o.fText;
        fPayload = std::move(payload);
    }
    return *this;
}

TCIMValue& TCIMValue::operator=(TCIMValue&& o) noexcept {
    fType = o.fType;
    fIsArray = o.fIsArray;
    fIsNull = o.fIsNull;
    fNum = o.fNum;
    fText = std::move(o.fText);
    fPayload = std::move(o.fPayload);
    return *this;
}

TCIMValue::~TCIMValue() = default;

TCIMValue TCIMValue::Null(ECIMType type, bool isArray) {
    TCIMValue v;
    v.fType = static_cast<std::uint8_t>(type);
    v.fIsArray = isArray;
    return v;
}

TCIMValue TCIMValue::Boolean(bool value) {
    TCIMValue v;
    v.fType = TType::eBoolean;
    v.fIsNull = false;
    v.fNum.b = value;
    return v;
}

TCIMValue TCIMValue::Unsigned(ECIMType type, std::uint64_t value) {
    if (!IsUnsignedType(type)) Fail(kTypeMismatch);
    if (value > UnsignedMax(type)) Fail(kOutOfRange);
    TCIMValue v;
    v.fType = static_cast<std::uint8_t>(type);
    v.fIsNull = false;
    v.fNum.u = value;
    return v;
}

TCIMValue TCIMValue::Signed(ECIMType type, std::int64_t value) {
    if (!IsSignedType(type)) Fail(kTypeMismatch);
    std::int64_t lo, hi;
    SignedRange(type, lo, hi);
    if (value < lo || value > hi) Fail(kOutOfRange);
    TCIMValue v;
    v.fType = static_cast<std::uint8_t>(type);
    v.fIsNull = false;
    v.fNum.i = value;
    return v;
}

TCIMValue TCIMValue::Real(ECIMType type, double value) {
    if (!IsRealType(type)) Fail(kTypeMismatch);
    TCIMValue v;
    v.fType = static_cast<std::uint8_t>(type);
    v.fIsNull = false;
    v.fNum.d = type == TType::eReal32 ? static_cast<double>(static_cast<float>(value)) : value;
    return v;
}

TCIMValue TCIMValue::Char16(const std::string& utf8Character) {
    TCIMValue v(utf8Character);
    v.fType = TType::eChar16;
    return v;
}

TCIMValue TCIMValue::Array(ECIMType elementType, std::vector<TCIMValue> elements) {
    TCIMValue v;
    v.fType = static_cast<std::uint8_t>(elementType);
    v.fIsArray = true;
    v.fIsNull = false;
    v.fPayload.reset(new THolder<std::vector<TCIMValue>>(std::move(elements)));
    return v;
}

TCIMValue TCIMValue::FromText(ECIMType type, const std::string& text) {
    switch (type) {
        case TType::eBoolean: {
            std::string t = Trim(text);
            for (auto& c : t) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
            if (t == "true") return Boolean(true);
            if (t == "false") return Boolean(false);
            Fail(kTypeMismatch);
        }
        case TType::eUint8:
        case TType::eUint16:
        case TType::eUint32:
        case TType::eUint64: {
            bool neg = false;
            std::uint64_t mag = 0;
            if (!ParseInteger(text, neg, mag)) Fail(kTypeMismatch);
            if (neg && mag != 0) Fail(kOutOfRange);
            return Unsigned(type, mag);
        }
        case TType::eSint8:
        case TType::eSint16:
        case TType::eSint32:
        case TType::eSint64: {
            bool neg = false;
            std::uint64_t mag = 0;
            if (!ParseInteger(text, neg, mag)) Fail(kTypeMismatch);
            const std::uint64_t limit = neg ? (std::uint64_t(1) << 63) : (std::uint64_t(1) << 63) - 1;
            if (mag > limit) Fail(kOutOfRange);
            std::int64_t value = neg ? static_cast<std::int64_t>(0 - mag) : static_cast<std::int64_t>(mag);
            return Signed(type, value);
        }
        case TType::eReal32:
        case TType::eReal64: {
            double d = 0;
            if (!ParseReal(text, d)) Fail(kTypeMismatch);
            if (type == TType::eReal32 && std::isfinite(d) && std::fabs(d) > std::numeric_limits<float>::max())
                Fail(kOutOfRange);
            return Real(type, d);
        }
        case TType::eChar16:
            if (!IsOneCharacter(text)) Fail(kTypeMismatch);
            return Char16(text);
        case TType::eString:
            return TCIMValue(text);
        case TType::eDateTime: {
            TCIMDateTime dt;
            if (!TCIMDateTime::Parse(Trim(text), dt)) Fail(kTypeMismatch);
            return TCIMValue(dt);
        }
        case TType::eReference: {
            TCIMReference ref;
            if (!TCIMReference::ParsePath(text, ref)) Fail(kTypeMismatch);
            return TCIMValue(ref);
        }
        default:
            Fail(kTypeMismatch);
    }
}

bool TCIMValue::ParseIntegerText(const std::string& text, bool& negative, std::uint64_t& magnitude) {
    return ParseInteger(text, negative, magnitude);
}

bool TCIMValue::ParseRealText(const std::string& text, double& out) { return ParseReal(text, out); }

const TCIMReference* TCIMValue::GetReference() const {
    if (fIsNull || fIsArray || fType != TType::eReference || !fPayload) return nullptr;
    return &Item<TCIMReference>(fPayload);
}

bool TCIMValue::operator==(const TCIMValue& o) const {
    if (fType != o.fType || fIsArray != o.fIsArray || fIsNull != o.fIsNull) return false;
    if (fIsNull) return true;
    if (fIsArray) return Item<std::vector<TCIMValue>>(fPayload) == Item<std::vector<TCIMValue>>(o.fPayload);
    switch (fType) {
        case TType::eBoolean: return fNum.b == o.fNum.b;
        case TType::eReal32:
        case TType::eReal64: return fNum.d == o.fNum.d;
        case TType::eString:
        case TType::eChar16: return fText == o.fText;
        case TType::eDateTime: return Item<TCIMDateTime>(fPayload) == Item<TCIMDateTime>(o.fPayload);
        case TType::eReference: return Item<TCIMReference>(fPayload) == Item<TCIMReference>(o.fPayload);
        default: return fNum.u == o.fNum.u;
    }
}

const TCIMValue& TCIMValue::RequireScalar() const {
    if (fIsNull) Fail(kNullValue);
    if (fIsArray) Fail(kTypeMismatch);
    return *this;
}

std::int64_t TCIMValue::AsSigned() const {
    RequireScalar();
    if (IsSignedType(fType)) return fNum.i;
    if (IsUnsignedType(fType)) {
        if (fNum.u > static_cast<std::uint64_t>(std::numeric_limits<std::int64_t>::max())) Fail(kOutOfRange);
        return static_cast<std::int64_t>(fNum.u);
    }
    if (fType == TType::eBoolean) return fNum.b ? 1 : 0;
    if (IsRealType(fType)) {
        if (!std::isfinite(fNum.d) || fNum.d >= 9.2233720368547758e18 || fNum.d < -9.2233720368547758e18)
            Fail(kOutOfRange);
        return static_cast<std::int64_t>(fNum.d);
    }
    if (IsTextType(fType)) return FromText(TType::eSint64, fText).fNum.i;
    Fail(kTypeMismatch);
}

std::uint64_t TCIMValue::AsUnsigned() const {
    RequireScalar();
    if (IsUnsignedType(fType)) return fNum.u;
    if (IsSignedType(fType)) {
        if (fNum.i < 0) Fail(kOutOfRange);
        return static_cast<std::uint64_t>(fNum.i);
    }
    if (fType == TType::eBoolean) return fNum.b ? 1 : 0;
    if (IsRealType(fType)) {
        if (!std::isfinite(fNum.d) || fNum.d < 0 || fNum.d >= 1.8446744073709552e19) Fail(kOutOfRange);
        return static_cast<std::uint64_t>(fNum.d);
    }
    if (IsTextType(fType)) return FromText(TType::eUint64, fText).fNum.u;
    Fail(kTypeMismatch);
}

double TCIMValue::AsReal() const {
    RequireScalar();
    if (IsRealType(fType)) return fNum.d;
    if (IsUnsignedType(fType)) return static_cast<double>(fNum.u);
    if (IsSignedType(fType)) return static_cast<double>(fNum.i);
    if (fType == TType::eBoolean) return fNum.b ? 1.0 : 0.0;
    if (IsTextType(fType)) return FromText(TType::eReal64, fText).fNum.d;
    Fail(kTypeMismatch);
}

namespace {

template <typename T>
T CheckedUnsigned(std::uint64_t v) {
    if (v > std::numeric_limits<T>::max()) Fail(kOutOfRange);
    return static_cast<T>(v);
}

}  // namespace

TCIMValue::operator bool() const {
    RequireScalar();
    if (fType == TType::eBoolean) return fNum.b;
    if (IsTextType(fType)) return FromText(TType::eBoolean, fText).fNum.b;
    if (IsRealType(fType)) return fNum.d != 0.0;
    if (IsUnsignedType(fType) || IsSignedType(fType)) return fNum.u != 0;
    Fail(kTypeMismatch);
}

TCIMValue::operator unsigned char() const { return CheckedUnsigned<unsigned char>(AsUnsigned()); }
TCIMValue::operator unsigned short() const { return CheckedUnsigned<unsigned short>(AsUnsigned()); }
TCIMValue::operator unsigned int() const { return CheckedUnsigned<unsigned int>(AsUnsigned()); }
TCIMValue::operator unsigned long() const { return static_cast<unsigned long>(AsUnsigned()); }

TCIMValue::operator int() const {
    std::int64_t v = AsSigned();
    if (v < std::numeric_limits<int>::min() || v > std::numeric_limits<int>::max()) Fail(kOutOfRange);
    return static_cast<int>(v);
}

TCIMValue::operator std::string() const { return ToString(10); }

TCIMValue::operator TCIMDateTime() const {
    RequireScalar();
    if (fType == TType::eDateTime) return Item<TCIMDateTime>(fPayload);
    if (IsTextType(fType)) {
        TCIMDateTime dt;
        if (TCIMDateTime::Parse(Trim(fText), dt)) return dt;
    }
    Fail(kTypeMismatch);
}

TCIMValue::operator TCIMReference() const {
    RequireScalar();
    if (fType == TType::eReference) return Item<TCIMReference>(fPayload);
    if (IsTextType(fType)) {
        TCIMReference ref;
        if (TCIMReference::ParsePath(fText, ref)) return ref;
    }
    Fail(kTypeMismatch);
}

TCIMValue::operator std::vector<TCIMValue>&() const {
    if (!fIsArray) Fail(kTypeMismatch);
    if (!fPayload) Fail(kNullValue);
    return Item<std::vector<TCIMValue>>(fPayload);
}

std::string TCIMValue::ToString(unsigned char radix) const {
    if (fIsNull) return std::string();
    if (fIsArray) {
        std::string out;
        bool first = true;
        for (const TCIMValue& e : Item<std::vector<TCIMValue>>(fPayload)) {
            if (!first) out += ',';
            first = false;
            out += e.ToString(radix);
        }
        return out;
    }
    switch (fType) {
        case TType::eBoolean: return fNum.b ? "true" : "false";
        case TType::eReal32: return FormatReal(fNum.d, true);
        case TType::eReal64: return FormatReal(fNum.d, false);
        case TType::eString:
        case TType::eChar16: return fText;
        case TType::eDateTime: return Item<TCIMDateTime>(fPayload).ToCIMString();
        case TType::eReference: return Item<TCIMReference>(fPayload).GetPath();
        default: break;
    }
    if (IsSignedType(fType)) return FormatSigned(fNum.i, radix);
    if (IsUnsignedType(fType)) return FormatUnsigned(fNum.u, radix);
    return std::string();
}

}  // namespace NORVTKR20
