#pragma once
// The base of every logical page of the clock wizard, with the helpers that
// several pages share.

#include "db/Tsy_WizData.h"
#include "wiz/Tsy_WizPage.h"

class QComboBox;
class Tsy_DCMwiz;
class Tsy_SpeedData;

class Tsy_DCMwizPage : public Tsy_WizPage {
public:
    enum DcmValueList { ListClkdvDivide = 0, ListPhaseShift = 1, ListDeskewAdjust = 2 };

    Tsy_DCMwizPage(Tsy_DCMwiz* wizard, int instNum);
    ~Tsy_DCMwizPage() override;

    bool ApplySilently() override { return true; }

    Tsy_DCMwiz* GetDCMWiz() const { return dcmWiz_; }
    int GetInstNum() const { return instNum_; }
    int GetWizType() const;
    Tsy_WizData* GetWizData() const;
    Tsy_SpeedData* GetSpeedData() const;
    StringBase GetFamily() const;
    bool IsBatch() const;

    Tsy_Block* GetActiveDCMBlk(int instNum, bool showMessage);
    Tsy_Block* GetActivePLLBlk(bool showMessage);
    Tsy_Block* GetActivePMCDBlk(int instNum);

    // The allowed values of CLKDV_DIVIDE, CLKOUT_PHASE_SHIFT or DESKEW_ADJUST
    // of the wizard's DCM primitive, in the work list.
    const Tsy_StrArray& GetDcmValueList(int which);
    // The allowed values of any attribute of a block's primitive, in order.
    static Tsy_StrArray ValueListOf(const Tsy_Block* block, const StringBase& attribute);
    static void FillComboBox(QComboBox* combo, const Tsy_StrArray& items);

    // Up to two DCM outputs the two-block application reserves for itself.
    static void GetApplicationClockOutputs(const Tsy_Block* block, int wizType, bool ddrClockOnly, StringBase& first,
                                           StringBase& second);
    // Whether the internal feedback output is also the application's clock.
    static bool IsFeedbackSharedWithAppClock(const Tsy_Block* block, int wizType);
    // The largest n of the pin's "TSY_CLKBUFTYPEn" records, 0 when none.
    static int GetHighestBufferIndex(const Tsy_Pin* pin);
    // The instance number a block carries, 0 when none.
    static int InstNumOf(const Tsy_Block* block);

protected:
    Tsy_StrArray& WorkList() { return workList_; }

private:
    int instNum_;
    Tsy_StrArray workList_;
    Tsy_DCMwiz* dcmWiz_;
};
