#pragma once
// An ordered, copyable list of strings.

#include "Port_StringBase.h"

#include <vector>

class Qvz_StrArray {
public:
    Qvz_StrArray() = default;
    Qvz_StrArray(std::initializer_list<const char*> items);

    int Add(const Port::StringBase& s);
    // "" past the end (or for a negative index).
    Port::StringBase GetAt(int i) const;
    // Past the end the array grows with "" entries; a negative index does nothing.
    void SetAt(int i, const Port::StringBase& s);
    void RemoveAt(int i);
    void RemoveAll() { m_items.clear(); }
    int GetSize() const { return static_cast<int>(m_items.size()); }
    bool IsEmpty() const { return m_items.empty(); }
    bool Contains(const Port::StringBase& s) const { return Find(s) >= 0; }
    // Index of the first exact match, or -1.
    int Find(const Port::StringBase& s) const;
    void Sort();

    const std::vector<Port::StringBase>& Items() const { return m_items; }
    friend bool operator==(const Qvz_StrArray& a, const Qvz_StrArray& b) {
        return a.m_items == b.m_items;
    }

private:
    std::vector<Port::StringBase> m_items;
};
