#include "Port_StringBase.h"

#include <climits>
#include <cstdarg>
#include <cstdio>
#include <cstring>
#include <vector>

namespace Port {

StringBase& StringBase::operator=(const char* text) {
    m_s = text ? text : "";
    return *this;
}

StringBase& StringBase::operator=(char c) {
    m_s.assign(1, c);
    return *this;
}

StringBase& StringBase::operator+=(const char* text) {
    if (text)
        m_s += text;
    return *this;
}

StringBase& StringBase::operator+=(const StringBase& other) {
    m_s += other.m_s;
    return *this;
}

StringBase& StringBase::operator+=(char c) {
    m_s += c;
    return *this;
}

int StringBase::Format(const char* format, ...) {
    if (!format) {
        m_s.clear();
        return 0;
    }
    va_list args;
    va_start(args, format);
    va_list copy;
    va_copy(copy, args);
    const int needed = std::vsnprintf(nullptr, 0, format, copy);
    va_end(copy);
    if (needed < 0) {
        va_end(args);
        m_s.clear();
        return 0;
    }
    std::vector<char> buf(static_cast<std::size_t>(needed) + 1);
    std::vsnprintf(buf.data(), buf.size(), format, args);
    va_end(args);
    m_s.assign(buf.data(), static_cast<std::size_t>(needed));
    return needed;
}

int StringBase::Compare(const char* text, int /*compareType*/) const {
    return std::strcmp(m_s.c_str(), text ? text : "");
}

int StringBase::Compare(const StringBase& other, int compareType) const {
    return Compare(other.c_str(), compareType);
}

std::size_t StringBase::GetIndexOfString(const char* text, int /*compareType*/) const {
    const std::size_t pos = m_s.find(text ? text : "");
    return pos == std::string::npos ? npos : pos;
}

std::size_t StringBase::GetIndexOfString(const StringBase& text, int compareType) const {
    return GetIndexOfString(text.c_str(), compareType);
}

void StringBase::Truncate(std::size_t n) {
    if (n < m_s.size())
        m_s.resize(n);
}

StringBase StringBase::Mid(std::size_t pos) const {
    return pos >= m_s.size() ? StringBase() : StringBase(m_s.substr(pos));
}

StringBase StringBase::Mid(std::size_t pos, std::size_t count) const {
    return pos >= m_s.size() ? StringBase() : StringBase(m_s.substr(pos, count));
}

StringBase StringBase::Right(std::size_t count) const {
    return count >= m_s.size() ? *this : StringBase(m_s.substr(m_s.size() - count));
}

} // namespace Port

namespace UT_STR {

int AToI(const char* text) {
    if (!text)
        return 0;
    const char* p = text;
    while (*p == ' ' || *p == '\t' || *p == '\n' || *p == '\r' || *p == '\v' || *p == '\f')
        ++p;
    bool negative = false;
    if (*p == '+' || *p == '-') {
        negative = (*p == '-');
        ++p;
    }
    // Accumulate as a negative number so INT_MIN is reachable without overflow.
    long long value = 0;
    const long long limit = static_cast<long long>(INT_MIN);
    bool saturated = false;
    for (; IsDigit(static_cast<unsigned char>(*p)); ++p) {
        if (saturated)
            continue;
        value = value * 10 - (*p - '0');
        if (value <= limit) {
            value = limit;
            saturated = true;
        }
    }
    if (negative)
        return static_cast<int>(value);
    if (value < -static_cast<long long>(INT_MAX))
        return INT_MAX;
    return static_cast<int>(-value);
}

int IsDigit(int c) {
    return c >= '0' && c <= '9';
}

Port::StringBase IToA(long long n) {
    return Port::StringBase(std::to_string(n));
}

} // namespace UT_STR
