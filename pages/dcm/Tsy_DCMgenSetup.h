#pragma once
// General Setup of one DCM: the input clock, the outputs, the feedback, the
// phase shift, the CLKDV divider and the less common options the Advanced
// dialog edits. The page reloads everything from its DCM block each time it
// is shown and writes it back, with the attributes derived from it, when the
// user leaves; leaving forward runs the validation chain first.

#include "wizard/Tsy_DCMwizPage.h"

#include <memory>

class Tsy_DCMgenSetupGui;

class Tsy_DCMgenSetup : public Tsy_DCMwizPage {
public:
    enum Units { UnitsMHz = 0, UnitsNs = 1 };
    // PsUnknown holds a stored value the page does not know; it is kept as
    // text so that nothing the user wrote is silently replaced.
    enum PsType { PsNone, PsFixed, PsVariablePositive, PsVariableCenter, PsVariable, PsDirect, PsUnknown };
    enum FbSource { FbSourceNone, FbSourceInternal, FbSourceExternal };
    enum FbValue { FbValueNone, FbValue1X, FbValue2X };
    enum PerfMode { PerfMaxSpeed = 0, PerfMaxRange = 1 };
    enum OutputType { OutputNone = 0, OutputDll = 1, OutputDfs = 2, OutputBoth = 3 };
    // The pin flags, in the order the block's pins are walked.
    enum Pin {
        PinRST,
        PinPSEN,
        PinPSINCDEC,
        PinPSCLK,
        PinCLK0,
        PinCLKFB,
        PinCLK90,
        PinCLK180,
        PinCLK270,
        PinCLKDV,
        PinCLK2X,
        PinCLK2X180,
        PinCLKFX,
        PinCLKFX180,
        PinSTATUS,
        PinLOCKED,
        PinPSDONE,
        PinCount
    };
    // Frequency-range report cases.
    enum RangeCase {
        CaseCascadeFirst = 0,
        CaseCascadeSecond = 1,
        CaseCascadeSecondClkdv = 2,
        CaseDll = 3,
        CaseDfs = 4,
        CaseDllAndDfs = 5,
        CaseMaxRange = 6
    };

    struct Settings {
        StringBase clkinText;
        Units units = UnitsMHz;
        StringBase clkdvDivide;
        PsType psType = PsNone;
        StringBase psTypeText; // the stored text when psType is PsUnknown
        StringBase psValue = "0";
        bool dutyCycle = true;
        FbSource fbSource = FbSourceInternal;
        FbValue fbValue = FbValue1X;
        bool fbDifferential = false;
        bool clkinInternal = false;
        bool clkinDifferential = false;
        bool divideBy2 = false;
        bool startupWait = false;
        StringBase deskewAdjust = "SYSTEM_SYNCHRONOUS";
        PerfMode perfMode = PerfMaxSpeed;
        bool reconfigPins = false;
        bool resetLogic = false;
        bool pmcdAvailable = false;
        bool pmcdSelected = false;
        StringBase pmcdMode;
        bool pins[PinCount] = {};
    };

    // The eight CLKIN range figures of the speed data, in MHz.
    struct Ranges {
        float dllLowMin = 0, dllLowMax = 0, dllHighMin = 0, dllHighMax = 0;
        float dfsLowMin = 0, dfsLowMax = 0, dfsHighMin = 0, dfsHighMax = 0;
    };

    Tsy_DCMgenSetup(Tsy_DCMwiz* wizard, int wizType, int instNum);
    ~Tsy_DCMgenSetup() override;

    bool ApplySilently() override;
    bool CreateGui(QWidget* parent) override;
    Gq_WizardPage* GetGui() override;

    bool LoadFromBlock();
    bool StoreToBlock(bool validate);

    // The validation chain; the first failing check stops it.
    bool ValidatePage(Tsy_Block* block);
    bool CheckInstanceName(Tsy_Block* block);
    void ComputeFrequencyModes(const StringBase& text, bool doubledOutput, Units units);
    void LoadFrequencyRanges(bool doubledOutput);
    void ReportFrequencyRanges(int reportCase);
    // 0 in no range, 1 low only, 2 high only, 3 both; bounds inclusive.
    static int ClassifyFrequency(float f, float lowMin, float lowMax, float highMin, float highMax);

    void ComputePhaseShiftLimits();
    void ComputePhaseShiftDisplay();
    // The figures of another value than the one set (the form's, held to the
    // limits while the user edits).
    void ComputePhaseShiftDisplay(int value);
    // Turns the phase shift off where the frequency mode does not allow it.
    // True while the phase shift cannot be edited (also while there is no
    // input frequency to compute it from).
    bool RestrictPhaseShift(bool warn);

    // The input frequency at the DCM in MHz: the entry read in its units,
    // halved by the input divider; 0 when the text is not a number.
    static float EffectiveFrequency(const StringBase& text, Units units, bool divideBy2);
    // CLKIN_PERIOD for an entry: the period at the DCM, "%3.3f".
    static StringBase ClkinPeriodText(const StringBase& text, Units units, bool divideBy2);
    // The entry rebuilt from a stored period, "%3.3f".
    static StringBase ClkinTextFromPeriod(const StringBase& period, Units units, bool divideBy2);
    static const char* PsTypeName(PsType type);
    static PsType PsTypeFromText(const StringBase& text);
    static const char* PinName(int pin);

    Settings& GetSettings() { return s_; }
    const Settings& GetSettings() const { return s_; }
    int GetOutputType() const;
    bool SelectedInHighFrequencyMode() const;
    bool SelectedWithoutValidRange() const;
    // Reset logic needs RST; it is never offered to the second DCM of a
    // cascade or after a PLL.
    bool IsResetLogicAllowed() const;
    // The output that closes an internal feedback loop, empty otherwise.
    StringBase FeedbackOutput() const;
    // 2X feedback is refused on these families.
    bool Is2XFeedbackRefused() const;
    bool IsReservedOutput(int pin) const;
    // The second DCM of board deskew and cascading takes its input from the
    // first; clock switching shares only the units.
    bool IsInputDerived() const;
    bool AreUnitsDerived() const;

    float GetInputFrequency() const { return inputFreq_; }
    int GetDllMode() const { return dllMode_; }
    int GetDfsMode() const { return dfsMode_; }
    const Ranges& GetRanges() const { return ranges_; }
    int GetPsLowest() const { return psLowest_; }
    int GetPsHighest() const { return psHighest_; }
    double GetPsDegrees() const { return psDegrees_; }
    double GetPsNs() const { return psNs_; }
    bool IsGeneration45() const { return gen45_; }
    bool IsMembra3EClass() const { return membra3e_; }
    const StringBase& GetFamilyKey() const { return family_; }
    int GetWizTypeOfPage() const { return wizType_; }
    StringBase GetPageTitle() const;
    StringBase GetWindowTitle() const;
    // The DCM primitive the symbol shows for the family.
    StringBase GetSymbolPrimitive() const;

private:
    void readSettings(Tsy_Block* block);
    void deriveSecondInput(Tsy_Block* block);
    void tidyBlock(Tsy_Block* block);
    // The steps of StoreToBlock, in the order it takes them.
    void settleDerivedSettings();
    void activateBlock(Tsy_Block* block);
    void storeInputFrequency(Tsy_Block* block);
    void storeOutputShaping(Tsy_Block* block);
    void storeClockSources(Tsy_Block* block);
    void storeStartupOptions(Tsy_Block* block);
    void storeGeneration45Options(Tsy_Block* block);
    void storeFrequencyModes(Tsy_Block* block);
    void storeFamilyAttributes(Tsy_Block* block);
    void storePins(Tsy_Block* block);
    void storeFeedbackMarks(Tsy_Block* block);
    // CheckInstanceName's steps.
    void renameFromPrimitiveName(Tsy_Block* block);
    StringBase freeInstanceName(const StringBase& wanted, const Tsy_Block* block) const;
    bool checkInstanceNameIsLegal(Tsy_Block* block);
    void warnIfModuleNamedAfterPrimitive();
    bool checkListValues();
    bool checkFrequencyModes();
    bool checkFeedback();
    bool checkOutputRange(bool clkdv);
    bool checkPhaseShift();
    bool checkStartupWait();
    void stepNote();
    // Questions in a window; in batch mode the question is written as a note
    // and the batch answer returned.
    int ask(const StringBase& question, int batchAnswer);
    float speed(const char* keyPattern, const char* fill);
    StringBase rangeLine(const char* format, float min, float max) const;
    // ReportFrequencyRanges' message: the reason, then the valid ranges.
    bool isMaxRangeMode() const;
    StringBase rangeReportReason(int reportCase) const;
    StringBase outOfRangeReason() const;
    StringBase rangeReportFigures(int reportCase) const;

    int wizType_;
    StringBase family_;
    bool gen45_;
    bool membra3e_;
    Settings s_;
    StringBase reserved_[2];
    // The default setup is where a new design starts, once; later visits
    // show what the user left.
    bool defaultSetupDone_ = false;

    float inputFreq_ = 0;
    Ranges ranges_;
    int dllMode_ = 0;
    int dfsMode_ = 0;
    int psLowest_ = -255;
    int psHighest_ = 255;
    double psDegrees_ = 0;
    double psNs_ = 0;

    std::unique_ptr<Tsy_DCMgenSetupGui> gui_;
};
