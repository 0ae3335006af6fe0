#include <vorl/Common/dStatus.h>

#include <algorithm>
#include <limits>
#include <ostream>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Common/detail/FormatText.h>

inline namespace vorl {

namespace {

constexpr std::int32_t kSuccess = 0;
constexpr std::int32_t kFailure = -1;

std::int32_t CodeOf(bool ok) {
  return ok ? kSuccess : kFailure;
}

std::int32_t CodeOf(long code) {
  return static_cast<std::int32_t>(std::clamp<long long>(
      code, std::numeric_limits<std::int32_t>::min(), std::numeric_limits<std::int32_t>::max()));
}

}  // namespace

using vorl_detail::AppendText;
using vorl_detail::StoreText;

// Formats the variable arguments behind `format` into a local FormatBuffer named `text`.
#define VORL_FORMAT_ARGUMENTS(text, format)           \
  vorl_detail::FormatBuffer text;                     \
  do {                                                \
    std::va_list arguments;                           \
    va_start(arguments, format);                      \
    vorl_detail::FormatText(text, format, arguments); \
    va_end(arguments);                                \
  } while (false)

VORL_REGISTER_CLASS(dStatus, DataBase);

dStatus::dStatus() : m_code(kFailure) {}

dStatus::dStatus(long code, const char* text) : m_code(CodeOf(code)) {
  vorl_detail::FormatBuffer formatted;
  vorl_detail::FormatTextWithoutArguments(formatted, text);
  StoreText(m_message, formatted.data());
}

dStatus::dStatus(bool ok, const char* text) : dStatus(static_cast<long>(CodeOf(ok)), text) {}

dStatus::dStatus(int code, const char* text) : dStatus(static_cast<long>(code), text) {}

dStatus::dStatus(const dStatus& source) : DataBase(source), m_code(source.m_code) {
  StoreText(m_message, source.m_message);
}

dStatus::~dStatus() = default;

void dStatus::Reset() {
  m_code = kSuccess;
  m_message.clear();
}

bool dStatus::IsValid() {
  return true;
}

dStatus& dStatus::operator=(const dStatus& source) {
  if (this != &source) {
    m_code = source.m_code;
    StoreText(m_message, source.m_message);
  }
  return *this;
}

dStatus& dStatus::operator=(long code) {
  m_code = CodeOf(code);
  return *this;
}

dStatus& dStatus::operator=(int code) {
  m_code = code;
  return *this;
}

dStatus& dStatus::operator=(bool ok) {
  m_code = CodeOf(ok);
  if (ok) {
    m_message.clear();
  }
  return *this;
}

dStatus& dStatus::operator=(const char* text) {
  StoreText(m_message, text != nullptr ? text : "");
  return *this;
}

dStatus& dStatus::operator=(const std::string& text) {
  StoreText(m_message, text);
  return *this;
}

dStatus& dStatus::operator+=(const char* text) {
  AppendText(m_message, text != nullptr ? text : "");
  return *this;
}

dStatus& dStatus::operator+=(const std::string& text) {
  AppendText(m_message, text);
  return *this;
}

bool dStatus::operator==(const dStatus& other) const {
  return m_code == other.m_code;
}
bool dStatus::operator!=(const dStatus& other) const {
  return m_code != other.m_code;
}
bool dStatus::operator==(long code) const {
  return m_code == code;
}
bool dStatus::operator!=(long code) const {
  return m_code != code;
}
bool dStatus::operator==(int code) const {
  return m_code == code;
}
bool dStatus::operator!=(int code) const {
  return m_code != code;
}
bool dStatus::operator==(bool ok) const {
  return IsOK() == ok;
}
bool dStatus::operator!=(bool ok) const {
  return IsOK() != ok;
}

dStatus::operator long() const {
  return m_code;
}

dStatus::operator const char*() const {
  return m_message.c_str();
}

bool dStatus::IsOK() const {
  return m_code == kSuccess;
}

void dStatus::Set(const dStatus& cause, const char* format, ...) {
  VORL_FORMAT_ARGUMENTS(text, format);
  std::string causeMessage;  // `cause` may be this status
  StoreText(causeMessage, cause.m_message);
  m_code = cause.m_code;
  StoreText(m_message, text.data());
  AppendText(m_message, causeMessage);
}

void dStatus::Set(long code, const char* format, ...) {
  VORL_FORMAT_ARGUMENTS(text, format);
  m_code = CodeOf(code);
  StoreText(m_message, text.data());
}

void dStatus::Set(int code, const char* format, ...) {
  VORL_FORMAT_ARGUMENTS(text, format);
  m_code = code;
  StoreText(m_message, text.data());
}

void dStatus::Set(bool ok, const char* format, ...) {
  VORL_FORMAT_ARGUMENTS(text, format);
  m_code = CodeOf(ok);
  StoreText(m_message, text.data());
}

void dStatus::SetMsg(const char* format, ...) {
  VORL_FORMAT_ARGUMENTS(text, format);
  m_code = kSuccess;
  StoreText(m_message, text.data());
}

void dStatus::AddMsg(const char* format, ...) {
  VORL_FORMAT_ARGUMENTS(text, format);
  AppendText(m_message, text.data());
}

std::ostream& operator<<(std::ostream& out, const dStatus& status) {
  return out << static_cast<long>(status) << ": " << static_cast<const char*>(status);
}

}  // namespace vorl
