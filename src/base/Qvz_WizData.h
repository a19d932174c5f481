#pragma once
// The design data a host hands to a wizard: library blocks with their
// attributes and pins, the signals of the design, and the target's facts.

#include "Port_StringBase.h"
#include "Qvz_NamedList.h"
#include "Qvz_StrArray.h"

#include <memory>
#include <vector>

using Port::StringBase;

// A name/value pair: the attributes of pins and signals.
struct Qvz_NameValue {
    StringBase name;
    StringBase value;
    friend bool operator==(const Qvz_NameValue& a, const Qvz_NameValue& b) {
        return a.name == b.name && a.value == b.value;
    }
};

// Ordered name/value list with unique names; shared by pins and signals.
class Qvz_NameValueList {
public:
    const std::vector<Qvz_NameValue>& Items() const { return m_items; }
    std::vector<Qvz_NameValue>& Items() { return m_items; }
    const Qvz_NameValue* Find(const StringBase& name) const;
    StringBase GetValue(const StringBase& name) const;
    bool Has(const StringBase& name) const { return Find(name) != nullptr; }
    // Replaces the value of an existing entry, else appends one.
    void Set(const StringBase& name, const StringBase& value);
    void Remove(const StringBase& name);
    friend bool operator==(const Qvz_NameValueList& a, const Qvz_NameValueList& b) {
        return a.m_items == b.m_items;
    }

private:
    std::vector<Qvz_NameValue> m_items;
};

class Qvz_Attribute : public Qvz_Named<Qvz_Attribute> {
public:
    Qvz_Attribute(const StringBase& name, const StringBase& value)
        : Qvz_Named(name), m_value(value), m_default(value) {}

    const StringBase& GetValue() const { return m_value; }
    void SetValue(const StringBase& v) { m_value = v; }
    const StringBase& GetDefaultValue() const { return m_default; }
    void SetDefaultValue(const StringBase& v) { m_default = v; }
    bool IsEditable() const { return m_editable; }
    void SetEditable(bool b) { m_editable = b; }
    bool IsChanged() const { return m_changed; }
    void SetChanged(bool b) { m_changed = b; }
    Qvz_StrArray& GetLegalValues() { return m_legal; }
    const Qvz_StrArray& GetLegalValues() const { return m_legal; }

    // A legal-value entry "LOW..HIGH" (two decimal integers) is a range.
    static bool IsValueRange(const StringBase& text);
    // LOW and HIGH of a range entry; false (and both left alone) otherwise.
    static bool GetRangeValues(const StringBase& text, int& low, int& high);

    friend bool operator==(const Qvz_Attribute& a, const Qvz_Attribute& b);

private:
    StringBase m_value;
    StringBase m_default;
    bool m_editable = true;
    bool m_changed = false;
    Qvz_StrArray m_legal;
};

// The widest pin or signal that design data can hold: wider ones would be
// saved to files that no reader takes back.
constexpr int Qvz_MaxWidth = 65536;

class Qvz_Pin : public Qvz_Named<Qvz_Pin> {
public:
    // Bit maps are pin attributes with this prefix.
    static constexpr const char* kBitMapPrefix = "QVZX_ONLY_PIN_SIG_BIT_";

    Qvz_Pin(const StringBase& name, const StringBase& direction)
        : Qvz_Named(name), m_direction(direction) {}

    const StringBase& GetDirection() const { return m_direction; }
    void SetDirection(const StringBase& d) { m_direction = d; }
    const StringBase& GetSigName() const { return m_signal; }
    void SetSigName(const StringBase& name) { m_signal = name; }
    bool IsUsed() const { return m_used; }
    void SetIsUsed(bool b) { m_used = b; }
    bool IsGrounded() const { return m_grounded; }
    void SetIsGrounded(bool b) { m_grounded = b; }
    bool IsVcc() const { return m_vcc; }
    void SetIsVcc(bool b) { m_vcc = b; }
    int GetWidth() const { return m_width; }
    // Widths are at least 1.
    void SetWidth(int w) { m_width = w < 1 ? 1 : w; }
    bool SupportsDataWidth() const { return m_dataWidth; }
    void SetSupportsDataWidth(bool b) { m_dataWidth = b; }

    // No signal, no tie, no bit map.
    void ClearAllConnections();

    // Adds or replaces the map of pin bits pinHigh..pinLow onto
    // signal[sigHigh:sigLow].
    void SetPinSigBitProp(const StringBase& signal, int pinHigh, int pinLow, int sigHigh,
                          int sigLow);
    bool HasPinSigBitProp() const;
    void RemoveAllPinSigBitProps();
    static bool IsBitMapName(const StringBase& attrName);

    StringBase GetAttributeValue(const StringBase& name) const { return m_attrs.GetValue(name); }
    bool HasAttribute(const StringBase& name) const { return m_attrs.Has(name); }
    void SetAttributeValue(const StringBase& name, const StringBase& v) { m_attrs.Set(name, v); }
    void RemoveAttribute(const StringBase& name) { m_attrs.Remove(name); }
    const std::vector<Qvz_NameValue>& GetAttributes() const { return m_attrs.Items(); }
    Qvz_NameValueList& AttributeList() { return m_attrs; }

    void AddFlag(const StringBase& flag);
    bool HasFlag(const StringBase& flag) const { return m_flags.Contains(flag); }
    const Qvz_StrArray& GetFlags() const { return m_flags; }

    friend bool operator==(const Qvz_Pin& a, const Qvz_Pin& b);

private:
    StringBase m_direction;
    StringBase m_signal;
    int m_width = 1;
    bool m_dataWidth = false;
    bool m_used = false;
    bool m_grounded = false;
    bool m_vcc = false;
    Qvz_StrArray m_flags;
    Qvz_NameValueList m_attrs;
};

class Qvz_Signal : public Qvz_Named<Qvz_Signal> {
public:
    explicit Qvz_Signal(const StringBase& name) : Qvz_Named(name) {}
    Qvz_Signal(const Qvz_Signal&) = default;
    Qvz_Signal& operator=(const Qvz_Signal&) = default;
    virtual ~Qvz_Signal() = default;

    int GetWidth() const { return m_width; }
    void SetWidth(int w) { m_width = w < 1 ? 1 : w; }
    bool IsBus() const { return m_bus; }
    void SetIsBus(bool bus, int width) {
        m_bus = bus;
        SetWidth(width);
    }
    bool IsExternal() const { return m_external; }
    const StringBase& GetDirection() const { return m_direction; }
    void SetIsExternal(bool external, const StringBase& direction) {
        m_external = external;
        m_direction = direction;
    }
    bool IsConst0() const { return m_const0; }
    void SetIsConst0(bool b) { m_const0 = b; }
    bool IsConst1() const { return m_const1; }
    void SetIsConst1(bool b) { m_const1 = b; }
    bool IsUsed() const { return m_used; }
    void SetIsUsed(bool b) { m_used = b; }

    StringBase GetAttributeValue(const StringBase& name) const { return m_attrs.GetValue(name); }
    bool HasAttribute(const StringBase& name) const { return m_attrs.Has(name); }
    void SetAttributeValue(const StringBase& name, const StringBase& v) { m_attrs.Set(name, v); }
    void RemoveAttribute(const StringBase& name) { m_attrs.Remove(name); }
    const std::vector<Qvz_NameValue>& GetAttributes() const { return m_attrs.Items(); }

    friend bool operator==(const Qvz_Signal& a, const Qvz_Signal& b);

private:
    int m_width = 1;
    bool m_bus = false;
    bool m_external = false;
    StringBase m_direction;
    bool m_const0 = false;
    bool m_const1 = false;
    bool m_used = false;
    Qvz_NameValueList m_attrs;
};

enum class Qvz_Family { Unknown, GT, GT10, GT11 };

// "GT11_" GT11, "GT10_" GT10, "GT_" GT, anything else Unknown.
Qvz_Family Qvz_FamilyOfPrimitive(const StringBase& primitive);
const char* Qvz_FamilyName(Qvz_Family f);

class Qvz_Block : public Qvz_Named<Qvz_Block> {
public:
    Qvz_Block(const StringBase& name, const StringBase& primitive, Qvz_Family family);
    Qvz_Block(const Qvz_Block& other) = default;
    Qvz_Block& operator=(const Qvz_Block&) = delete;

    const StringBase& GetPrimitiveName() const { return m_primitive; }
    Qvz_Family GetFamily() const { return m_family; }
    bool SupportsMGT3() const { return m_family == Qvz_Family::GT; }
    bool SupportsMGT10() const { return m_family == Qvz_Family::GT10; }
    bool SupportsMGT11() const { return m_family == Qvz_Family::GT11; }
    bool IsUsed() const { return m_used; }
    void SetIsUsed(bool b) { m_used = b; }

    // Attributes, in order.
    const std::vector<std::unique_ptr<Qvz_Attribute>>& GetAttributes() const {
        return m_attrs.All();
    }
    Qvz_Attribute* GetNamedAttribute(const StringBase& name) const;
    StringBase GetAttributeValue(const StringBase& name) const;
    // Sets the value, adding the attribute when missing.
    void SetAttributeValue(const StringBase& name, const StringBase& value);
    // Adds (default = value, editable, unchanged, no legal values) or replaces
    // the value of an existing attribute; returns it.
    Qvz_Attribute* AddAttribute(const StringBase& name, const StringBase& value);
    void RemoveAttribute(const StringBase& name);
    void DeleteAttribute(Qvz_Attribute* attr);
    bool HasAttrWPrefix(const StringBase& prefix) const;

    // Pins, in order.
    const std::vector<std::unique_ptr<Qvz_Pin>>& GetPins() const { return m_pins.All(); }
    Qvz_Pin* GetNamedPin(const StringBase& name) const;
    // A name the block has already returns that pin unchanged.
    Qvz_Pin* AddPin(const StringBase& name, const StringBase& direction);
    void DeletePin(Qvz_Pin* pin);
    // Disconnects every pin from its signal and bit maps (ties stay).
    void ClearAllPinSignals();

    // Replaces attributes and pins with copies of other's.
    void CopyContentsFrom(const Qvz_Block& other);

    friend bool operator==(const Qvz_Block& a, const Qvz_Block& b);

private:
    StringBase m_primitive;
    Qvz_Family m_family;
    bool m_used = false;
    Qvz_NamedList<Qvz_Attribute> m_attrs;
    Qvz_NamedList<Qvz_Pin> m_pins;
};

// What the host knows of the target device.
struct Qvz_Target {
    bool supportsGT = false;
    bool supportsGT10 = false;
    bool supportsGT11 = false;
    int maxBondGT = 0;
    int maxBondGT10 = 0;
    int maxBondGT11 = 0;
    StringBase fileName;
    friend bool operator==(const Qvz_Target& a, const Qvz_Target& b);
};

class Qvz_WizData {
public:
    Qvz_WizData() = default;
    Qvz_WizData(const Qvz_WizData& other) = default;
    Qvz_WizData& operator=(const Qvz_WizData& other) = default;
    Qvz_WizData(Qvz_WizData&& other) noexcept = default;
    Qvz_WizData& operator=(Qvz_WizData&& other) noexcept = default;

    Qvz_Target& Target() { return m_target; }
    const Qvz_Target& Target() const { return m_target; }

    // Blocks, in order. Pointers stay valid until the block is deleted.
    // Lookups by name take constant time; with names repeated, the first
    // in order is found.
    const std::vector<std::unique_ptr<Qvz_Block>>& GetBlocks() const { return m_blocks.All(); }
    // Appends a block; returns it (null when the name exists).
    Qvz_Block* AddBlock(std::unique_ptr<Qvz_Block> block);
    // Appends without looking the name up, for callers that have made sure
    // the name is new. Returns the block.
    Qvz_Block* AppendNewBlock(std::unique_ptr<Qvz_Block> block);
    Qvz_Block* GetActiveBlock() const;
    Qvz_Block* GetNamedBlock(const StringBase& name) const;
    Qvz_Block* GetPrimitiveBlock(const StringBase& primitive) const;
    // A copy of block named name, placed after the last block. A block of
    // that name already there gets block's attributes and pins instead.
    Qvz_Block* CopyBlock(const Qvz_Block* block, const StringBase& name);
    void DeleteBlock(Qvz_Block* block);
    void SetAllBlksIsActive(bool b);

    // Signals, in order.
    const std::vector<std::unique_ptr<Qvz_Signal>>& GetSignals() const { return m_signals.All(); }
    Qvz_Signal* GetNamedSignal(const StringBase& name) const;
    // New signals are used; an existing one is marked used and otherwise left alone.
    Qvz_Signal* AddSignal(const StringBase& name, bool external, const StringBase& direction);
    // Adds a copy; an existing name is marked used and returned instead.
    Qvz_Signal* AddSignal(const Qvz_Signal& signal);
    // Appends without looking the name up (see AppendNewBlock); the signal
    // keeps its own flags. Returns the signal.
    Qvz_Signal* AppendNewSignal(std::unique_ptr<Qvz_Signal> signal);
    void DeleteSignal(Qvz_Signal* signal);
    void SetAllSigsIsActive(bool b);

    friend bool operator==(const Qvz_WizData& a, const Qvz_WizData& b);

private:
    Qvz_Target m_target;
    Qvz_NamedList<Qvz_Block> m_blocks;
    Qvz_NamedList<Qvz_Signal> m_signals;
};
