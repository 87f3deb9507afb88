#pragma once
// One buffer of one source output, as the View/Edit Buffer dialog edits it:
// its type, its inputs I0 and I1 and the names of the signals on its ports,
// and the rules that write them onto the I0 pin. It holds no widget, so the
// Clock Buffers page can also store a row without showing the dialog (batch
// runs, Finish in PMCD designs); the dialog reads its form into it.

#include "port/StringBase.h"

#include <vector>

class Tsy_Block;
class Tsy_DCMwizPage;
class Tsy_Pin;

class Tsy_BufferEdit {
public:
    // One member per port name; "I" and "I0" share the input, "S" and "S0"
    // the select, "CE" and "CE0" the enable.
    enum Slot { SlotIn, SlotI1, SlotS, SlotS1, SlotCE, SlotCE1, SlotIgnore0, SlotIgnore1, SlotO, SlotCount };

    struct PortDef {
        const char* name;
        Slot slot;
    };

    // The IGNORE pins of a BUFGCTRL take a signal or a tie.
    static constexpr const char* kIgnoreSignal = "signal";

    explicit Tsy_BufferEdit(Tsy_DCMwizPage* page);

    // Forgets the last buffer.
    void Reset();
    // Loads one grid row. outputs are the source outputs the page lists (as
    // shown, "U2 CLKA1" in parallel PMCD designs); a new buffer chooses its
    // I0 among them. bufNum 0 stands for the first buffer.
    void Prepare(int wizType, int instNum, const StringBase& pmcdMode, int pmcdInst, const StringBase& prefix,
                 const std::vector<StringBase>& outputs, const StringBase& i0, const StringBase& i1,
                 const StringBase& type, int bufNum, bool isNew);

    // The ports whose signal names a type records, in pin order.
    static std::vector<PortDef> PortsOf(const StringBase& type);
    static bool HasSlot(const StringBase& type, Slot slot);

    int GetWizType() const { return wizType_; }
    int GetInstNum() const { return instNum_; }
    const StringBase& GetPmcdMode() const { return pmcdMode_; }
    bool IsParallelPmcd() const;
    bool IsPmcdDesign() const;
    bool IsPllDesign() const;
    const std::vector<StringBase>& GetOutputs() const { return outputs_; }

    const StringBase& GetI0() const { return i0_; }
    const StringBase& GetI1() const { return i1_; }
    const StringBase& GetType() const { return type_; }
    const StringBase& GetOriginalType() const { return origType_; }
    int GetBufferNumber() const { return bufNum_; }
    bool IsNewBuffer() const { return isNew_; }
    bool IsDeleted() const { return deleted_; }
    bool IsBatch() const { return batch_; }
    const StringBase& GetPrefix() const { return prefix_; }

    void SetI0(const StringBase& i0) { i0_ = i0; }
    void SetI1(const StringBase& i1) { i1_ = i1; }
    void SetType(const StringBase& type) { type_ = type; }
    // Set when the page stores a row at Finish without showing the dialog.
    void SetSilent(bool silent) { silent_ = silent; }
    bool IsSilent() const { return silent_; }

    // The signal on a port: the name given for it, else the default name.
    StringBase GetSignalName(Slot slot) const;
    StringBase GetDefaultName(Slot slot) const;
    // Whether the name was chosen rather than computed.
    bool IsNameGiven(Slot slot) const { return given_[slot]; }
    // An empty name returns the port to its default name.
    void SetSignalName(Slot slot, const StringBase& name);
    // "signal", "GND" or "VCC" for IGNORE0 (which 0) and IGNORE1 (which 1).
    const StringBase& GetIgnoreChoice(int which) const { return ignore_[which ? 1 : 0]; }
    void SetIgnoreChoice(int which, const StringBase& choice) { ignore_[which ? 1 : 0] = choice; }

    // The pin name and PMCD instance behind a shown output ("U2 CLKA1" gives
    // CLKA1 and 2; a plain name gives itself and fallbackInst).
    static StringBase PinNameOf(const StringBase& shown, int fallbackInst, int* inst = nullptr);
    // The block whose pins carry the records of this buffer, and its I0 pin.
    Tsy_Block* SourceBlock() const;
    Tsy_Pin* I0Pin() const;
    Tsy_Block* DcmBlock() const;

    // "Select buffer for DCM pin CLK0" and the like.
    StringBase GroupTitle() const;
    // A buffer may go when its pin keeps another one, or when it feeds from CLKIN.
    bool CanDelete() const;

    // The dialog's OK: the selection and name checks, then the store. True
    // when the dialog may close.
    bool Ok();
    // The dialog's Delete: either the buffer goes at once (then true) or the
    // refusal is reported and the type choice goes back to the original.
    bool Delete();
    // Writes the records onto the I0 pin; false when the pin is missing.
    bool StoreToPin();

private:
    void loadRecordedNames();
    bool checkGivenNames();
    StringBase base() const;
    StringBase i0Pin() const;
    StringBase i1Pin() const;
    static bool isNone(const StringBase& s);

    Tsy_DCMwizPage* page_;
    int wizType_ = 0;
    int instNum_ = 1;
    StringBase pmcdMode_ = "NONE";
    int pmcdInst_ = 1;
    StringBase prefix_;
    std::vector<StringBase> outputs_;
    StringBase i0_;
    StringBase i1_;
    StringBase type_;
    StringBase origType_;
    int bufNum_ = 0;
    StringBase names_[SlotCount];
    bool given_[SlotCount] = {};
    StringBase ignore_[2];
    bool batch_ = false;
    bool isNew_ = false;
    bool deleted_ = false;
    bool silent_ = false;
};
