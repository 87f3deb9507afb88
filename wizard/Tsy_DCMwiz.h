#pragma once
// The clock wizard: the one class the plug-in exports. It decides the page
// set of each wizard type, names the pages' Back and Next buttons, loads the
// speed data, finds or creates the clock blocks the pages edit, and hands
// over to design generation at Finish.

#include "wiz/Tsy_WizMain.h"

#define TSY_EXPORT __attribute__((visibility("default")))

class Gq_ImageManager;
class Tsy_Block;
class Tsy_SpeedData;
class Tsy_WizData;

class TSY_EXPORT Tsy_DCMwiz : public Tsy_WizMain {
public:
    enum WizType {
        TypeNone = 0,
        TypeDcm = 1,
        TypeBoardDeskew = 2,
        TypeClockForwarding = 3,
        TypeClockSwitching = 4,
        TypeCascading = 5,
        TypePll = 6,
        TypeDcmToPll = 7,
        TypePllToDcm = 8
    };

    Tsy_DCMwiz(const StringBase& keyword, bool batch);
    Tsy_DCMwiz(const Tsy_DCMwiz& other);
    Tsy_DCMwiz& operator=(const Tsy_DCMwiz& other);
    ~Tsy_DCMwiz() override;

    bool InstantiatePages() override;
    bool CustomizeGui(Gq_Wizard* wizard) override;
    int Finish() override;
    Tsy_Block* ResolveTarget(const StringBase& target, StringBase& reason) override;

    bool FinishDCMWiz();
    bool LoadSpdFile(bool batch);

    static int ConvertWizTypeStr(const StringBase& keyword);
    // Types 1, 3, 7 and 8 use one DCM; 2, 4 and 5 use instances 1 and 2.
    static bool IsSingleDcmType(int wizType);
    // Whether this build can run the wizard type from start to Finish.
    static bool IsTypeAvailable(int wizType);

    Tsy_Block* GetActiveDCMBlk(int instNum, bool showMessage);
    Tsy_Block* GetActivePLLBlk(bool showMessage);
    Tsy_Block* GetActivePMCDBlk(int instNum);
    StringBase AddDCMPrefix(const StringBase& name, int which) const;

    int GetWizTypeInt() const { return wizType_; }
    Gq_ImageManager* GetImPtr() const { return imageManager_; }
    Tsy_SpeedData* GetSpdDataPtr() const { return speedData_; }
    bool IsSpdFileLoaded() const { return spdLoaded_; }
    void SetSpdFileFlag(bool loaded) { spdLoaded_ = loaded; }
    Tsy_WizData* GetDesignData() const { return designData_; }
    // The name of the page in a slot, from the type's table.
    StringBase GetPageName(int slot) const;

private:
    void reportMissing(const char* text) const;

    int wizType_;
    Gq_ImageManager* imageManager_;
    Tsy_SpeedData* speedData_;
    bool spdLoaded_;
    Tsy_WizData* designData_;
    StringBase pageNames_[kPageSlots];
    bool ownsSpeedData_ = true;
};

extern "C" TSY_EXPORT Tsy_WizMain* pendra_create_wizard(const char* keyword, bool batch);
