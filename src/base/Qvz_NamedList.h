#pragma once
// An owned, ordered list of named items with lookup by name in constant
// time. Designs carry millions of signals and blocks with thousands of pins,
// and the finish routine looks a name up for every pin it decides: a linear
// search made that quadratic.
//
// Names may repeat (a reader that trusts its input, a rename onto a name in
// use); a lookup then returns the first in order, as a search from the front
// would. Items tell their list when they are renamed, so the index never
// goes stale behind its back.

#include "Port_StringBase.h"

#include <algorithm>
#include <functional>
#include <memory>
#include <string_view>
#include <vector>

template <typename T> class Qvz_NamedList;

// Base of the items a Qvz_NamedList holds: the name, and the list the item
// is in. A copy belongs to no list until it is added to one.
template <typename T> class Qvz_Named {
public:
    const Port::StringBase& GetName() const { return m_name; }
    void SetName(const Port::StringBase& name) {
        if (name == m_name)
            return;
        if (m_list)
            m_list->Unlink(Self());
        m_name = name;
        if (m_list)
            m_list->Link(Self());
    }

protected:
    explicit Qvz_Named(const Port::StringBase& name) : m_name(name) {}
    Qvz_Named(const Qvz_Named& other) : m_name(other.m_name) {}
    Qvz_Named& operator=(const Qvz_Named& other) {
        SetName(other.m_name);
        return *this;
    }
    ~Qvz_Named() = default;

private:
    friend class Qvz_NamedList<T>;
    T* Self() { return static_cast<T*>(this); }

    Port::StringBase m_name;
    Qvz_NamedList<T>* m_list = nullptr;
};

template <typename T> class Qvz_NamedList {
public:
    using Items = std::vector<std::unique_ptr<T>>;

    Qvz_NamedList() = default;
    ~Qvz_NamedList() { Disown(); }
    // A copy holds copies of the items.
    Qvz_NamedList(const Qvz_NamedList& other) { CopyFrom(other); }
    Qvz_NamedList& operator=(const Qvz_NamedList& other) {
        if (this != &other) {
            Clear();
            CopyFrom(other);
        }
        return *this;
    }
    Qvz_NamedList(Qvz_NamedList&& other) noexcept { TakeFrom(other); }
    Qvz_NamedList& operator=(Qvz_NamedList&& other) noexcept {
        if (this != &other) {
            Clear();
            TakeFrom(other);
        }
        return *this;
    }

    const Items& All() const { return m_items; }
    std::size_t Size() const { return m_items.size(); }

    // The first item of that name, or null. Not safe to call from two
    // threads at once: a lookup may (re)build the index.
    T* Find(const Port::StringBase& name) const {
        if (!m_indexed)
            Reindex();
        if (m_slots.empty())
            return nullptr;
        const std::string_view key = name.str();
        return m_slots[Probe(key, Hash(key))].item;
    }

    // Appends the item (null is ignored); returns it.
    T* Append(std::unique_ptr<T> item) {
        if (!item)
            return nullptr;
        T* raw = item.get();
        m_items.push_back(std::move(item));
        raw->m_list = this;
        // Last in order: an earlier item of the same name stays the first.
        if (m_indexed && !Insert(raw))
            m_repeats = true;
        return raw;
    }

    // Removes and destroys the item; an item not in the list is ignored.
    void Erase(const T* item) {
        if (!item || item->m_list != this)
            return;
        Unlink(const_cast<T*>(item));
        m_items.erase(std::remove_if(m_items.begin(), m_items.end(),
                                     [item](const auto& p) { return p.get() == item; }),
                      m_items.end());
    }

    void Clear() {
        Disown();
        m_items.clear();
        m_slots.clear();
        m_count = 0;
        m_indexed = true;
        m_repeats = false;
    }

private:
    friend class Qvz_Named<T>;

    // Open addressing with linear probing: one allocation for the whole
    // index, where a node per name made building it for a million signals
    // cost more than the lookups it saves.
    struct Slot {
        std::size_t hash = 0;
        T* item = nullptr;
    };

    static std::size_t Hash(std::string_view key) { return std::hash<std::string_view>()(key); }
    std::size_t Mask() const { return m_slots.size() - 1; }

    // The slot holding key, or the empty slot where it would go.
    std::size_t Probe(std::string_view key, std::size_t hash) const {
        std::size_t i = hash & Mask();
        while (m_slots[i].item && (m_slots[i].hash != hash ||
                                   std::string_view(m_slots[i].item->GetName().str()) != key))
            i = (i + 1) & Mask();
        return i;
    }

    // False when the name is taken already.
    bool Insert(T* item) const {
        if ((m_count + 1) * 2 > m_slots.size())
            Resize(std::max<std::size_t>(16, m_slots.size() * 2));
        const std::string_view key = item->GetName().str();
        const std::size_t hash = Hash(key);
        const std::size_t i = Probe(key, hash);
        if (m_slots[i].item)
            return false;
        m_slots[i] = {hash, item};
        ++m_count;
        return true;
    }

    void Resize(std::size_t size) const {
        std::vector<Slot> old(size);
        old.swap(m_slots);
        for (const Slot& s : old)
            if (s.item) {
                std::size_t i = s.hash & Mask();
                while (m_slots[i].item)
                    i = (i + 1) & Mask();
                m_slots[i] = s;
            }
    }

    // Takes the item's slot out, shifting back the entries probed past it so
    // that no search stops short at the hole.
    void Remove(std::size_t hole) {
        for (std::size_t j = (hole + 1) & Mask(); m_slots[j].item; j = (j + 1) & Mask()) {
            const std::size_t home = m_slots[j].hash & Mask();
            if (((j - home) & Mask()) >= ((j - hole) & Mask())) {
                m_slots[hole] = m_slots[j];
                hole = j;
            }
        }
        m_slots[hole] = Slot();
        --m_count;
    }

    void Link(T* item) {
        // Which of two items of one name comes first is a question of
        // order: let the next lookup settle it.
        if (m_indexed && !Insert(item)) {
            m_repeats = true;
            m_indexed = false;
        }
    }

    // Called while the item still has the name it is indexed under.
    void Unlink(T* item) {
        if (!m_indexed || m_slots.empty())
            return;
        const std::string_view key = item->GetName().str();
        const std::size_t i = Probe(key, Hash(key));
        if (m_slots[i].item != item)
            return;
        Remove(i);
        // A later item of the same name may now be the first.
        if (m_repeats)
            m_indexed = false;
    }

    void Reindex() const {
        std::size_t size = 16;
        while (size < m_items.size() * 2)
            size *= 2;
        m_slots.assign(size, Slot());
        m_count = 0;
        m_repeats = false;
        for (const auto& p : m_items)
            if (!Insert(p.get()))
                m_repeats = true;
        m_indexed = true;
    }

    void CopyFrom(const Qvz_NamedList& other) {
        m_items.reserve(other.m_items.size());
        for (const auto& p : other.m_items) {
            m_items.push_back(std::make_unique<T>(*p));
            m_items.back()->m_list = this;
        }
        // A copy of a list that is looked up in will be too; indexing it now,
        // while its names are fresh in the cache, costs less than later.
        m_indexed = false;
        if (other.m_indexed)
            Reindex();
    }

    // The items stay where they are, so the index holds for them still.
    void TakeFrom(Qvz_NamedList& other) {
        m_items = std::move(other.m_items);
        m_slots = std::move(other.m_slots);
        m_count = other.m_count;
        m_indexed = other.m_indexed;
        m_repeats = other.m_repeats;
        other.m_items.clear();
        other.Clear();
        for (auto& p : m_items)
            p->m_list = this;
    }

    void Disown() {
        for (auto& p : m_items)
            p->m_list = nullptr;
    }

    Items m_items;
    // Built on the first lookup: a reader or a copy that never looks a name
    // up pays nothing for it. It holds the first item of each name.
    mutable std::vector<Slot> m_slots;
    mutable std::size_t m_count = 0;
    mutable bool m_indexed = false;
    mutable bool m_repeats = false;
};
