#pragma once
// Value strings of the portability layer, plus the decimal helpers the pages use.

#include <QString>
#include <cstddef>
#include <string>

namespace Port {

// CompareType 0 (substring searches) and 1 (equality tests) behave alike here:
// both are exact and case-sensitive.
enum CompareType { CompareSearch = 0, CompareExact = 1 };

class StringBase {
public:
    // "All ones": what GetIndexOfString answers when the text is absent.
    static constexpr std::size_t npos = static_cast<std::size_t>(-1);

    StringBase() = default;
    StringBase(const char* text) : m_s(text ? text : "") {}
    StringBase(const std::string& text) : m_s(text) {}
    StringBase(std::string&& text) : m_s(std::move(text)) {}

    StringBase& operator=(const char* text);
    StringBase& operator=(char c);
    StringBase& operator+=(const char* text);
    StringBase& operator+=(const StringBase& other);
    StringBase& operator+=(char c);

    // printf-style; replaces the contents. Returns the new length.
    int Format(const char* format, ...)
#if defined(__GNUC__)
        __attribute__((format(printf, 2, 3)))
#endif
        ;

    // 0 when equal, non-zero otherwise (ordering like strcmp).
    int Compare(const char* text, int compareType) const;
    int Compare(const StringBase& other, int compareType) const;

    // Position of the first occurrence, or npos when absent.
    std::size_t GetIndexOfString(const char* text, int compareType) const;
    std::size_t GetIndexOfString(const StringBase& text, int compareType) const;

    void Truncate(std::size_t n);

    std::size_t GetLength() const { return m_s.size(); }
    bool IsEmpty() const { return m_s.empty(); }
    const char* c_str() const { return m_s.c_str(); }
    const std::string& str() const { return m_s; }
    // Character i, or '\0' past the end.
    char GetAt(std::size_t i) const { return i < m_s.size() ? m_s[i] : '\0'; }
    // Text from pos to the end (empty past the end).
    StringBase Mid(std::size_t pos) const;
    StringBase Mid(std::size_t pos, std::size_t count) const;
    StringBase Left(std::size_t count) const { return Mid(0, count); }
    StringBase Right(std::size_t count) const;

    QString ToQString() const { return QString::fromStdString(m_s); }
    static StringBase FromQString(const QString& s) { return StringBase(s.toStdString()); }

    friend bool operator==(const StringBase& a, const StringBase& b) { return a.m_s == b.m_s; }
    friend bool operator!=(const StringBase& a, const StringBase& b) { return a.m_s != b.m_s; }
    friend bool operator==(const StringBase& a, const char* b) { return a.m_s == (b ? b : ""); }
    friend bool operator!=(const StringBase& a, const char* b) { return !(a == b); }
    friend bool operator<(const StringBase& a, const StringBase& b) { return a.m_s < b.m_s; }
    friend StringBase operator+(StringBase a, const StringBase& b) { return a += b; }
    friend StringBase operator+(StringBase a, const char* b) { return a += b; }

private:
    std::string m_s;
};

} // namespace Port

namespace UT_STR {
// Decimal value of text: optional leading blanks, optional sign, digits up to
// the first other character. Saturates at the int range; non-numeric gives 0.
int AToI(const char* text);
inline int AToI(const Port::StringBase& text) { return AToI(text.c_str()); }
// Non-zero for '0'..'9'.
int IsDigit(int c);
// Decimal text of n.
Port::StringBase IToA(long long n);
} // namespace UT_STR
