#pragma once
// The Clock Frequency Synthesizer page: the multiply and divide values M and
// D of the DCM's synthesized output (CLKFX, CLKFX180), derived from a wanted
// output frequency or typed directly, checked against the synthesizer ranges
// of the speed data and the frequency mode General Setup allowed, with the
// expected period jitter of the output.

#include "wizard/Tsy_DCMwizPage.h"

#include <memory>

class Tsy_JitCalcHF;
class Tsy_JitCalcLF;
class Tsy_JitterDlgGui;

class Tsy_JitterDlg : public Tsy_DCMwizPage {
public:
    enum InputType { InputOutputFrequency = 0, InputMAndD = 1 };
    enum Units { UnitsMhz = 0, UnitsNs = 1 };
    // The synthesizer modes the input clock allows, as General Setup found.
    enum DfsMode { DfsLow = 1, DfsHigh = 2, DfsBoth = 3 };
    // Synthesizer mode of an output: none, low or high frequency.
    enum SynthMode { SynthNone = 0, SynthLow = 1, SynthHigh = 2 };

    static constexpr int kMinM = 2;
    static constexpr int kMaxM = 32;
    static constexpr int kMinD = 1;
    static constexpr int kMaxD = 32;

    // A frequency range of the speed data, in MHz, bounds included. A mode
    // the part lacks has its range start at 0 (its maximum may still carry a
    // family-wide cap); such a range holds no frequency.
    struct Range {
        float min = 0.0f;
        float max = 0.0f;
        bool Exists() const { return min > 0.0f && max >= min; }
        bool Contains(double mhz) const { return Exists() && mhz >= min && mhz <= max; }
    };

    Tsy_JitterDlg(Tsy_DCMwiz* wizard, int instNum);
    ~Tsy_JitterDlg() override;

    bool ApplySilently() override;
    bool CreateGui(QWidget* parent) override;
    Gq_WizardPage* GetGui() override;

    // Reads the page's settings from the DCM block and calculates; false
    // without a block.
    bool LoadFromBlock();
    // With validate, checks and calculates first and stores M, D and the
    // jitter; without, keeps only what the user entered (leaving by Back).
    bool StoreToBlock(bool validate);
    // Derives M, D and the output from the entries and computes the jitter.
    // Without showMessages the checks fail silently.
    bool Calculate(bool showMessages);

    // The entries, as the form edits them.
    InputType GetInputType() const { return inputType_; }
    void SetInputType(InputType type) { inputType_ = type; }
    Units GetOutputUnits() const { return foutUnits_; }
    // Switching units turns a typed frequency into its period and back.
    void SetOutputUnits(Units units);
    const StringBase& GetFoutText() const { return foutText_; }
    void SetFoutText(const StringBase& text) { foutText_ = text; }
    const StringBase& GetMText() const { return mText_; }
    void SetMText(const StringBase& text) { mText_ = text; }
    const StringBase& GetDText() const { return dText_; }
    void SetDText(const StringBase& text) { dText_ = text; }

    // What the last calculation gave; HasResult is false after a failure.
    bool HasResult() const { return hasResult_; }
    int GetResultM() const { return resultM_; }
    int GetResultD() const { return resultD_; }
    double GetResultFoutMhz() const { return resultFout_; }
    SynthMode GetSynthMode() const { return synthMode_; }
    // The jitter figures of the model in force, as the form shows them.
    StringBase GetJitterUiText() const;
    StringBase GetJitterPk2PkText() const;

    // What the form shows around the entries.
    double GetInputMhz() const { return finMhz_; }
    // The units of the selected input: the output units when the output
    // frequency is entered, the input clock's units for M and D.
    Units GetDisplayUnits() const;
    // The input clock as "100 MHz", "100 MHz => divided by 2 = 50.000 MHz" ...
    StringBase GetInputClockText() const;
    StringBase GetInputClockLine() const;
    StringBase GetRangeTableTitle() const;
    // "%3.3f - %3.3f" of a synthesizer input or output range in the display
    // units (periods with the smaller first).
    StringBase GetRangeText(bool high, bool output) const;
    StringBase GetRangeHeader(bool output) const;
    StringBase GetOutputText() const;
    StringBase GetOutputHeader() const;
    StringBase GetPageTitle() const;
    StringBase GetFormCaption() const;
    // The two jitter captions of the wizard type; empty where the form's
    // own captions stand.
    void GetJitterCaptions(StringBase& ui, StringBase& pk2pk) const;

    // The model of the generation-4/5 class: fin and fout in MHz, d as the
    // page holds it, high for the high-frequency synthesizer mode and the
    // block's DCM_PERFORMANCE_MODE. Gives peak-to-peak ns and unit interval.
    static void Gen45Jitter(const StringBase& family, float fin, float fout, float d, bool high,
                            const StringBase& performanceMode, float& pk2pkNs, float& unitInterval);
    // The DCM's effective input frequency in MHz from its block.
    static double EffectiveInputMhz(const Tsy_Block* block);

private:
    bool loadRanges();
    bool deriveFromOutput(bool show);
    bool deriveFromMAndD(bool show);
    bool finishDerivation(bool show);
    bool fitsAllowedMode() const;
    void reportMisfit(bool show);
    bool checkCascading(bool show);
    bool checkEntryRanges(bool show);
    void message(const StringBase& text, bool show);
    bool runningSilently() const;
    bool usesSynthesizerOutputs() const { return outputType_ == OutFx || outputType_ == OutBoth; }
    StringBase rangeText(const Range& r, Units units) const;

    enum OutputType { OutNone = 0, OutDll = 1, OutFx = 2, OutBoth = 3 };

    // Entries.
    InputType inputType_ = InputOutputFrequency;
    Units foutUnits_ = UnitsMhz;
    StringBase foutText_;
    StringBase mText_ = "4";
    StringBase dText_ = "1";

    // What the block says of the input clock and of General Setup's choices.
    StringBase finText_;
    Units finUnits_ = UnitsMhz;
    bool divideBy2_ = false;
    StringBase clkinPeriod_;
    double finMhz_ = 0.0;
    OutputType outputType_ = OutNone;
    DfsMode allowedDfs_ = DfsLow;
    StringBase performanceMode_;

    // Speed data.
    Range finLow_, finHigh_, foutLow_, foutHigh_;

    // Results.
    bool hasResult_ = false;
    int resultM_ = 0;
    int resultD_ = 0;
    double resultFout_ = 0.0;
    SynthMode synthMode_ = SynthNone;
    bool outInLow_ = false;
    bool outInHigh_ = false;
    float jitterUi_ = 0.0f;
    float jitterPk2Pk_ = 0.0f;

    bool silentRun_ = false;
    std::unique_ptr<Tsy_JitCalcLF> calcLF_;
    std::unique_ptr<Tsy_JitCalcHF> calcHF_;
    Tsy_JitterDlgGui* gui_ = nullptr;
};
