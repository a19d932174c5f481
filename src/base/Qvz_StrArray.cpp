#include "Qvz_StrArray.h"

#include <algorithm>

Qvz_StrArray::Qvz_StrArray(std::initializer_list<const char*> items) {
    for (const char* s : items)
        m_items.emplace_back(s);
}

int Qvz_StrArray::Add(const Port::StringBase& s) {
    m_items.push_back(s);
    return GetSize() - 1;
}

Port::StringBase Qvz_StrArray::GetAt(int i) const {
    if (i < 0 || i >= GetSize())
        return Port::StringBase();
    return m_items[static_cast<std::size_t>(i)];
}

void Qvz_StrArray::SetAt(int i, const Port::StringBase& s) {
    if (i < 0)
        return;
    if (i >= GetSize())
        m_items.resize(static_cast<std::size_t>(i) + 1);
    m_items[static_cast<std::size_t>(i)] = s;
}

void Qvz_StrArray::RemoveAt(int i) {
    if (i >= 0 && i < GetSize())
        m_items.erase(m_items.begin() + i);
}

int Qvz_StrArray::Find(const Port::StringBase& s) const {
    for (std::size_t i = 0; i < m_items.size(); ++i)
        if (m_items[i] == s)
            return static_cast<int>(i);
    return -1;
}

void Qvz_StrArray::Sort() {
    std::stable_sort(m_items.begin(), m_items.end());
}
