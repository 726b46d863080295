// Script values held in C++, and their conversions as the script language defines them.
#include "ASValue.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstring>

namespace ae {
namespace stagecraft {

namespace {

bool IsBlank(char c) { return c == ' ' || c == '\t' || c == '\n' || c == '\v' || c == '\f' || c == '\r'; }

// ToNumber of a text: decimal literals with an optional sign and exponent, "0x" hexadecimal,
// "Infinity"; blanks around it are ignored, blank text is 0, anything else is NaN.
double TextToNumber(const std::string& text) {
  const char* p = text.data();
  const char* end = p + text.size();
  while (p < end && IsBlank(*p)) ++p;
  while (end > p && IsBlank(end[-1])) --end;
  if (p == end) return 0;
  if (end - p > 2 && p[0] == '0' && (p[1] == 'x' || p[1] == 'X')) {
    double value = 0;
    for (const char* q = p + 2; q < end; ++q) {
      int digit;
      if (*q >= '0' && *q <= '9') digit = *q - '0';
      else if (*q >= 'a' && *q <= 'f') digit = *q - 'a' + 10;
      else if (*q >= 'A' && *q <= 'F') digit = *q - 'A' + 10;
      else return NAN;
      value = value * 16 + digit;
    }
    return value;
  }
  double sign = 1;
  if (*p == '+' || *p == '-') {
    sign = *p == '-' ? -1 : 1;
    ++p;
  }
  if (std::string(p, end) == "Infinity") return sign * INFINITY;
  if (p == end || !((*p >= '0' && *p <= '9') || *p == '.')) return NAN;  // no "inf", "nan"
  double value = 0;
  std::from_chars_result r = std::from_chars(p, end, value, std::chars_format::general);
  if (r.ec != std::errc() || r.ptr != end) return NAN;
  return sign * value;
}

// ToString of a number: the shortest digits that read back to the same number, placed as
// the script language does ("1.5", "100", "1e+21", "1.5e-7").
std::string NumberToText(double value) {
  if (std::isnan(value)) return "NaN";
  if (value == 0) return "0";
  if (value < 0) return "-" + NumberToText(-value);
  if (std::isinf(value)) return "Infinity";
  char buf[64];
  std::to_chars_result r = std::to_chars(buf, buf + sizeof buf, value, std::chars_format::scientific);
  std::string sci(buf, r.ptr);  // "d.ddde+XX" or "de+XX"
  size_t e = sci.find('e');
  std::string digits = sci.substr(0, e);
  digits.erase(std::remove(digits.begin(), digits.end(), '.'), digits.end());
  int k = static_cast<int>(digits.size());
  int n = std::stoi(sci.substr(e + 1)) + 1;  // value = 0.digits * 10^n
  if (k <= n && n <= 21) return digits + std::string(n - k, '0');
  if (0 < n && n <= 21) return digits.substr(0, n) + "." + digits.substr(n);
  if (-6 < n && n <= 0) return "0." + std::string(-n, '0') + digits;
  std::string exponent = (n - 1 >= 0 ? "e+" : "e-") + std::to_string(std::abs(n - 1));
  if (k == 1) return digits + exponent;
  return digits.substr(0, 1) + "." + digits.substr(1) + exponent;
}

int NumberToInt32(double value) {
  if (!std::isfinite(value)) return 0;
  double m = std::fmod(std::trunc(value), 4294967296.0);
  if (m < 0) m += 4294967296.0;
  if (m >= 2147483648.0) m -= 4294967296.0;
  return static_cast<int>(m);
}

}  // namespace

int ASValue::AsInteger() const { return NumberToInt32(AsNumber()); }

double ASValue::AsNumber() const {
  switch (m_Kind) {
    case kBoolean: return m_Boolean ? 1 : 0;
    case kNumber: return m_Number;
    case kString: return TextToNumber(m_String);
    case kObject: return m_Object.ToNumber();
    case kNull: return 0;
    case kUndefined: break;
  }
  return NAN;
}

bool ASValue::AsBoolean() const {
  switch (m_Kind) {
    case kBoolean: return m_Boolean;
    case kNumber: return m_Number != 0 && !std::isnan(m_Number);
    case kString: return !m_String.empty();
    case kObject: return true;
    case kNull:
    case kUndefined: break;
  }
  return false;
}

AEString ASValue::AsString() const {
  switch (m_Kind) {
    case kBoolean: return AEString(m_Boolean ? "true" : "false");
    case kNumber: {
      std::string text = NumberToText(m_Number);
      return AEString(text.data(), text.size());
    }
    case kString: return AEString(m_String.data(), m_String.size());
    case kObject: {
      std::string text = m_Object.ToText();
      return AEString(text.data(), text.size());
    }
    case kNull:
    case kUndefined: break;
  }
  return AEString();
}

ASObject ASValue::AsObject() const { return m_Kind == kObject ? m_Object : ASObject(); }

void ASValue::SetUndefined() { *this = ASValue(); }

void ASValue::SetNull() {
  SetUndefined();
  m_Kind = kNull;
}

void ASValue::SetInteger(int value) { SetNumber(value); }

void ASValue::SetNumber(double value) {
  SetUndefined();
  m_Kind = kNumber;
  m_Number = value;
}

void ASValue::SetBoolean(bool value) {
  SetUndefined();
  m_Kind = kBoolean;
  m_Boolean = value;
}

void ASValue::SetString(const char* text) { SetString(text, text ? strlen(text) : 0); }

void ASValue::SetString(const char* bytes, size_t length) {
  std::string text(bytes ? bytes : "", bytes ? length : 0);  // before clearing: bytes may be ours
  SetUndefined();
  m_Kind = kString;
  m_String.swap(text);
}

void ASValue::SetObject(const ASObject& object) {
  ASObject copy(object);
  SetUndefined();
  if (!copy.IsValid()) return;
  m_Kind = kObject;
  m_Object = copy;
}

const ASValue& ASValueArray::Get(size_t index) const {
  static const ASValue kUndefinedValue;
  return index < m_Values.size() ? m_Values[index] : kUndefinedValue;
}

}  // namespace stagecraft
}  // namespace ae
