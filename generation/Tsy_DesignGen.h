#pragma once
// The design generator run at Finish: it turns the attribute values the pages
// left on the clock blocks into a netlist of blocks, pins, nets and ports in
// the design database. One generator is made per Finish.
//
// Every block and net name a step makes passes through the wizard's
// AddDCMPrefix with the step's instance index k (0 for the single-DCM types,
// 1 and 2 for the two DCMs of board deskew, clock switching and cascading).
// Names the designer typed (the buffer records of the View/Edit Buffer
// dialog) are taken as they are, but only when they are legal Verilog and
// VHDL names; any other is refused with a message and the Finish fails.

#include "port/StringBase.h"

#include <memory>

class Tsy_Block;
class Tsy_DCMwiz;
class Tsy_Pin;
class Tsy_Signal;
class Tsy_WizData;

class Tsy_DesignGen {
public:
    // Null when there is no design to build into.
    static std::unique_ptr<Tsy_DesignGen> Create(Tsy_DCMwiz* wizard, int wizType);
    Tsy_DesignGen(Tsy_DCMwiz* wizard, int wizType, Tsy_WizData* data);

    // Wizard types 0 to 5. False when a block is missing or a step refused
    // what the pages left (a message says which).
    bool GenerateDCMDesign();
    // Wizard types 6, 7 and 8.
    bool GeneratePLLDesign();
    bool GenerateDCMToPLLDesign();
    bool GeneratePLLToDCMDesign();

    // ---- Building steps, shared by the DCM and the PLL designs.

    // Strips the routing marks and associations every signal carries from an
    // earlier Finish.
    void Prepare();
    // The DCM's CLKIN: from the first DCM's input buffer (board deskew), from
    // the cascading buffer (second DCM of cascading), from an input port or
    // through an input buffer.
    void InputClock(Tsy_Block* block, int k);
    // The DCM's CLKFB: a global buffer from CLK0 or CLK2X, an input buffer, or
    // ground. With mirror set, the internal feedback clock also leaves the
    // design through the output port P("<output>_OUT").
    void Feedback(Tsy_Block* block, int k, bool mirror);
    // An IBUFG or IBUFGDS from the input port(s) of base to the target pin;
    // returns the buffer's output net.
    StringBase InputBuffer(Tsy_Pin* target, const StringBase& base, int k, bool differential, bool mirror);
    // A BUFG (or BUFGCE with enable) on the source pin. With a target its
    // output net P("<target>_IN") (named with targetK) drives the target, and
    // mirror adds the output port P("<source>_OUT") that the net names in
    // ASSOC_WITH; without a target it drives an output port. n is the
    // buffer's number in the source pin's records (0 for none). Returns the
    // output net or port.
    StringBase GlobalBuffer(Tsy_Pin* source, Tsy_Pin* target, int k, int n, bool enable, bool mirror, int targetK);
    // The buffers recorded on the block's outputs, and the input clock's.
    void OutputBuffers(Tsy_Block* block, int k);
    // Local routing or low-skew lines for a pin: an output port marked with
    // the routing directive.
    void LocalRouting(Tsy_Pin* pin, bool lowSkew, int k, int n);
    // Forwarding flip-flops, cascading and switching of the two-block wizards.
    void ApplicationLogic(Tsy_Block* dcm1, Tsy_Block* dcm2, int k);
    // The power-up reset pulse that holds the DCM in reset for its first
    // input clocks; partner is the first DCM of a cascade.
    void ResetLogic(Tsy_Block* block, int k, Tsy_Block* partner);
    // Ports for the DCM's remaining inputs and status outputs, ground for
    // the inputs not in use.
    void RemainingDcmPins(Tsy_Block* block, int k);

private:
    // The name passed through AddDCMPrefix.
    StringBase P(const StringBase& name, int k) const;
    void Report(const StringBase& text);

    // Names and database edits.
    bool IsActiveSignal(const StringBase& name) const;
    StringBase UniqueSignalName(const StringBase& name) const;
    StringBase UniqueBlockName(const StringBase& name) const;
    Tsy_Block* NewBlock(const StringBase& name, const StringBase& type);
    Tsy_Pin* Pin(Tsy_Block* block, const char* name, bool input);
    StringBase InputPort(const StringBase& name, int width = 1);
    StringBase OutputPort(const StringBase& name, int width = 1);
    StringBase NewNet(const StringBase& name);
    void Connect(Tsy_Pin* pin, const StringBase& net);
    // The pin's net; a new one named fallback when it has none.
    StringBase NetOf(Tsy_Pin* pin, const StringBase& fallback);
    void Tie(Tsy_Pin* pin, bool high);
    // A signal name the designer recorded for buffer n of the pin ("O", "CE"
    // ...); empty when there is none or it was refused.
    StringBase Recorded(const Tsy_Pin* pin, int n, const char* port);
    StringBase RecordedOr(const Tsy_Pin* pin, int n, const char* port, const StringBase& fallback);

    // Steps of the DCM design.
    void RetireGeneratedBlocks();
    Tsy_Block* FindDcmBlock(int inst);
    bool FindDcmBlocks(bool twoDcms);
    void BuildFirstDcm(int k, bool pmcdUse);
    void BuildSecondDcm();
    bool SharesFeedbackWithApplication(const Tsy_Block* block, int k) const;
    StringBase ForwardedOutput(const Tsy_Block* block) const;
    void OutputBuffer(Tsy_Pin* source, int k, int n);
    void OutputMux(Tsy_Block* block, Tsy_Pin* source, int k, int n, const StringBase& kind);
    // The input and output ports of a clock multiplexer.
    struct MuxPorts {
        StringBase select, s0, s1, ce0, ce1, ignore0, ignore1, out;
    };
    void BuildMux(const StringBase& kind, const StringBase& blockName, Tsy_Pin* i0, const StringBase& i0Net,
                  Tsy_Pin* i1, const StringBase& i1Net, const MuxPorts& ports);
    Tsy_Pin* ResolveMuxInput(Tsy_Block* block, const StringBase& text);
    void ClockForwarding(Tsy_Block* block, int k);
    // The DDR output flip-flops that can forward a clock;
    // ForwardingFlopNamed gives null for any other type.
    struct ForwardingFlop;
    static const ForwardingFlop* ForwardingFlopNamed(const StringBase& type);
    Tsy_Block* ForwardingFlipFlop(const ForwardingFlop& kind, const StringBase& fwd, int k);
    void SetOddrAttributes(const Tsy_Block* block, Tsy_Block* flop);
    void ForwardingClocks(Tsy_Block* block, Tsy_Block* flop, const ForwardingFlop& kind, Tsy_Pin* source,
                          const StringBase& fwd, int k);
    void ForwardingSecondClock(Tsy_Block* block, Tsy_Block* flop, const StringBase& clock, const StringBase& fwd,
                               int k);
    void Cascading(Tsy_Block* dcm1, Tsy_Block* dcm2);
    void ClockSwitching(Tsy_Block* dcm1, Tsy_Block* dcm2);
    StringBase LockedInverter(Tsy_Block* partner, int k);
    void PmcdPath(Tsy_Block* dcm1, int k);
    void PmcdConnections(Tsy_Block* dcm1, int k);
    Tsy_Pin* OutputPinNamed(Tsy_Block* block, const StringBase& name, const char* role);

    bool familyFlag_;
    int wizType_;
    Tsy_WizData* data_;
    Tsy_DCMwiz* wizard_;
    Tsy_Block* dcm1_ = nullptr;
    Tsy_Block* dcm2_ = nullptr;
    bool failed_ = false;
};

// Implemented by the page that keeps the buffer rows of the PMCD outputs:
// in PMCD designs generation hands that part of the netlist to it.
class Tsy_PmcdBufferBuilder {
public:
    virtual ~Tsy_PmcdBufferBuilder() = default;
    virtual bool GenerateBuffers() = 0;
};
