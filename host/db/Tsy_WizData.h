#pragma once
// The design database: blocks (instances of primitives) with pins, signals
// (nets and top-level ports) and text attributes on all three. The database
// owns everything; callers hold plain pointers, and every lookup returns null
// when it finds nothing.

#include "port/StringBase.h"

#include <memory>
#include <vector>

struct Tsy_AttrDef;
struct Tsy_PrimitiveDef;
class Tsy_PrimitiveLibrary;
class Tsy_Block;

class Tsy_StrArray {
public:
    int Add(const StringBase& s);
    StringBase GetAt(int i) const;
    int GetSize() const { return static_cast<int>(items_.size()); }
    bool Contains(const StringBase& s) const;
    bool IsEmpty() const { return items_.empty(); }
    void Empty() { items_.clear(); }
    const std::vector<StringBase>& Items() const { return items_; }

private:
    std::vector<StringBase> items_;
};

class Tsy_Attribute {
public:
    Tsy_Attribute(StringBase name, StringBase value, const Tsy_AttrDef* def);

    const StringBase& GetName() const { return name_; }
    const StringBase& GetValue() const { return value_; }
    void SetValue(const StringBase& value) { value_ = value; }
    bool IsActive() const { return active_; }
    void SetIsActive(bool active) { active_ = active; }

    // The definition from the primitive library, or null for attributes the
    // primitive does not define.
    const Tsy_AttrDef* GetDef() const { return def_; }
    void SetDef(const Tsy_AttrDef* def) { def_ = def; }
    // The allowed values of the definition, in order.
    Tsy_StrArray GetValueList() const;
    // Reads one value-list entry as a "min:max" range.
    bool GetRangeValues(const StringBase& key, int& low, int& high) const;
    // The HDL type of the definition ("string" without one).
    StringBase GetHdlType() const;

private:
    StringBase name_;
    StringBase value_;
    bool active_ = true;
    const Tsy_AttrDef* def_ = nullptr;
};

// Attributes in the order they were added.
class Tsy_AttrHolder {
public:
    Tsy_AttrHolder() = default;
    Tsy_AttrHolder(const Tsy_AttrHolder& other);
    Tsy_AttrHolder& operator=(const Tsy_AttrHolder& other);
    virtual ~Tsy_AttrHolder() = default;

    // Empty when absent.
    StringBase GetAttributeValue(const StringBase& name) const;
    // Sets the value, adding the attribute when absent; always succeeds.
    bool SetAttributeValue(const StringBase& name, const StringBase& value);
    // Adds the attribute, or sets its value when present; either way active.
    Tsy_Attribute* AddAttribute(const StringBase& name, const StringBase& value);
    bool RemoveAttribute(const StringBase& name);
    Tsy_Attribute* GetNamedAttribute(const StringBase& name) const;
    bool SetAttributeIsActive(const StringBase& name, bool active);
    // Removes every attribute whose name begins with the prefix.
    int RemoveAllPropsWBase(const StringBase& prefix);
    const std::vector<std::unique_ptr<Tsy_Attribute>>& Attributes() const { return attrs_; }

protected:
    // The definition an attribute of that name takes, if any.
    virtual const Tsy_AttrDef* DefinitionOf(const StringBase&) const { return nullptr; }

private:
    std::vector<std::unique_ptr<Tsy_Attribute>> attrs_;
};

class Tsy_Pin : public Tsy_AttrHolder {
public:
    Tsy_Pin(Tsy_Block* block, StringBase name, StringBase direction, int width);

    const StringBase& GetName() const { return name_; }
    const StringBase& GetDirection() const { return direction_; } // "IN" or "OUT"
    bool IsInput() const { return direction_ == "IN"; }
    Tsy_Block* GetBlock() const { return block_; }
    int GetWidth() const { return width_; }
    void SetWidth(int width) { width_ = width < 1 ? 1 : width; }
    bool IsActive() const { return active_; }
    void SetIsActive(bool active) { active_ = active; }

    // Connects the pin to the net of that name (empty disconnects it).
    void SetSigName(const StringBase& signalName);
    const StringBase& GetSigName() const { return sigName_; }
    void SetIsGrounded(bool on);
    void SetIsVcc(bool on);
    bool IsGrounded() const { return grounded_; }
    bool IsVcc() const { return vcc_; }
    // No net and no tie.
    void ClearAllConnections();

private:
    friend class Tsy_Block;
    Tsy_Block* block_;
    StringBase name_;
    StringBase direction_;
    int width_ = 1;
    bool active_ = false;
    StringBase sigName_;
    bool grounded_ = false;
    bool vcc_ = false;
};

class Tsy_Block : public Tsy_AttrHolder {
public:
    Tsy_Block(StringBase name, StringBase type, const Tsy_PrimitiveDef* def);
    // A deep copy under another name; pins point at the copy.
    Tsy_Block(const Tsy_Block& other, const StringBase& newName);

    // Set and cleared directly by the wizard.
    bool active = false;

    const StringBase& GetName() const { return name_; }
    void SetName(const StringBase& name) { name_ = name; }
    const StringBase& GetType() const { return type_; }
    const Tsy_PrimitiveDef* GetDef() const { return def_; }
    // The template block of its primitive ("<type>_INST" of a new design).
    bool IsTemplate() const { return template_; }
    void SetIsTemplate(bool on) { template_ = on; }
    // Made by AddBlock: part of a generated netlist, which the next Finish
    // builds anew.
    bool IsGenerated() const { return generated_; }
    void SetIsGenerated(bool on) { generated_ = on; }

    // Adds a pin, or returns the pin of that name when there is one. Pins the
    // primitive defines take its width.
    Tsy_Pin* AddPin(const StringBase& pinName, const StringBase& direction);
    Tsy_Pin* GetNamedPin(const StringBase& name) const;
    bool DeletePin(Tsy_Pin* pin);
    void ClearAllPinSignals();
    void SetAllPinsIsActive(bool active);
    const std::vector<std::unique_ptr<Tsy_Pin>>& Pins() const { return pins_; }

    // Turns the block into another primitive: attributes and pins the new
    // primitive does not define are dropped (the wizard's own attributes stay),
    // missing ones are added from its definition, kept ones keep their state.
    void Retype(const StringBase& type, const Tsy_PrimitiveDef* def);
    // Adds the pins and attributes of the definition it lacks (templates).
    void FillFromDefinition();

protected:
    const Tsy_AttrDef* DefinitionOf(const StringBase& name) const override;

private:
    StringBase name_;
    StringBase type_;
    const Tsy_PrimitiveDef* def_;
    bool template_ = false;
    bool generated_ = false;
    std::vector<std::unique_ptr<Tsy_Pin>> pins_;
};

class Tsy_Signal : public Tsy_AttrHolder {
public:
    Tsy_Signal(StringBase name, bool external, StringBase direction);

    const StringBase& GetName() const { return name_; }
    bool IsExternal() const { return external_; }
    const StringBase& GetDirection() const { return direction_; } // "I", "O" or ""
    void SetExternal(bool external, const StringBase& direction);
    bool IsBus() const { return bus_; }
    int GetWidth() const { return bus_ ? width_ : 1; }
    void SetIsBus(bool bus, int width);
    bool IsActive() const { return active_; }
    void SetIsActive(bool active) { active_ = active; }

private:
    StringBase name_;
    bool external_;
    StringBase direction_;
    bool bus_ = false;
    int width_ = 1;
    bool active_ = true;
};

class Tsy_WizData {
public:
    // An empty database whose blocks take their definitions from the library.
    explicit Tsy_WizData(const Tsy_PrimitiveLibrary& library);
    ~Tsy_WizData();
    Tsy_WizData(const Tsy_WizData&) = delete;
    Tsy_WizData& operator=(const Tsy_WizData&) = delete;

    const Tsy_PrimitiveLibrary& Library() const { return lib_; }

    // Adds the inactive template block "<type>_INST" of a primitive.
    Tsy_Block* AddTemplateBlock(const StringBase& primType);

    Tsy_Block* GetNamedBlock(const StringBase& name) const;
    Tsy_Signal* GetNamedSignal(const StringBase& name) const;
    // The first active block of the type.
    Tsy_Block* GetActiveBlock(const StringBase& primType) const;
    // The active block of the type whose TESY_ONLY_INST_NUM is instNum.
    Tsy_Block* GetActiveBlockInstNum(const StringBase& primType, int instNum) const;
    // Any block of the type whose TESY_ONLY_INST_NUM is instNum.
    Tsy_Block* GetBlockInstNum(const StringBase& primType, int instNum) const;
    // The template block of the primitive.
    Tsy_Block* GetPrimitiveBlock(const StringBase& primType) const;

    // Turns the active block of one type (of that instance when instNum is
    // not 0) into the other type; null when there is none or the target type
    // is unknown.
    Tsy_Block* ConvertActiveBlk(const StringBase& fromType, const StringBase& toType, int instNum);
    // A copy of the block under a new name, inactive and not a template; null
    // when another block holds the name.
    Tsy_Block* CopyBlock(const Tsy_Block* block, const StringBase& newName);

    // A new active block of the primitive, without pins or attributes, marked
    // as generated; an inactive
    // non-template block of the same name is replaced. Null when an active
    // block or a template holds the name.
    Tsy_Block* AddBlock(const StringBase& instanceName, const StringBase& primType);
    // The signal of that name, made active and given the kind asked for; it
    // is created when absent.
    Tsy_Signal* AddSignal(const StringBase& name, bool isExternal, const StringBase& direction);
    bool RemoveBlock(Tsy_Block* block);

    void SetAllBlksIsActive(bool active);
    void SetAllSigsIsActive(bool active);

    const std::vector<std::unique_ptr<Tsy_Block>>& Blocks() const { return blocks_; }
    const std::vector<std::unique_ptr<Tsy_Signal>>& Signals() const { return signals_; }

private:
    Tsy_Block* insertBlock(std::unique_ptr<Tsy_Block> block);

    const Tsy_PrimitiveLibrary& lib_;
    std::vector<std::unique_ptr<Tsy_Block>> blocks_;
    std::vector<std::unique_ptr<Tsy_Signal>> signals_;
};
