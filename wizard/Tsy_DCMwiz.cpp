#include "wizard/Tsy_DCMwiz.h"

#include "db/Tsy_WizData.h"
#include "generation/Tsy_DesignGen.h"
#include "gui/Gq_ImageManager.h"
#include "gui/Gq_Wizard.h"
#include "gui/Gq_WizardPage.h"
#include "gui/Tsy_Wait2Dlg.h"
#include "wiz/Tsy_WizPage.h"
#include "wizard/Tsy_DCMwizPage.h"
#include "wizard/Tsy_PageSets.h"
#include "wizard/Tsy_SpeedData.h"
#include "wizard/Tsy_Vocabulary.h"

#include <memory>

extern const Gq_ImageEntry Tsy_EmbeddedImageTable[];

namespace {

const char* const kKeywords[] = {"dcm",           "dcm_bddeskew", "dcm_clkfwd",  "dcm_clkswitch",
                                 "dcm_cascading", "dcm_pll",      "dcm_dcm2pll", "dcm_pll2dcm"};

QString q(const StringBase& s)
{
    return QString::fromStdString(s.str());
}

} // namespace

Tsy_DCMwiz::Tsy_DCMwiz(const StringBase& keyword, bool batch)
    : Tsy_WizMain(keyword, batch), wizType_(ConvertWizTypeStr(keyword)),
      imageManager_(Gq_ImageManager::getInstance()), speedData_(nullptr), spdLoaded_(false), designData_(nullptr)
{
    // On a 64-bit host one entry is 24 bytes; the registry walks the table
    // with the size we give it.
    imageManager_->addImages(Tsy_EmbeddedImageTable, static_cast<int>(sizeof(Gq_ImageEntry)));
}

Tsy_DCMwiz::Tsy_DCMwiz(const Tsy_DCMwiz& other)
    : Tsy_WizMain(other), wizType_(other.wizType_), imageManager_(other.imageManager_),
      speedData_(other.speedData_), spdLoaded_(other.spdLoaded_), designData_(other.designData_),
      ownsSpeedData_(false)
{
    for (int i = 0; i < kPageSlots; ++i)
        pageNames_[i] = other.pageNames_[i];
}

Tsy_DCMwiz& Tsy_DCMwiz::operator=(const Tsy_DCMwiz& other)
{
    if (this == &other)
        return *this;
    if (ownsSpeedData_)
        delete speedData_;
    Tsy_WizMain::operator=(other);
    wizType_ = other.wizType_;
    imageManager_ = other.imageManager_;
    speedData_ = other.speedData_;
    spdLoaded_ = other.spdLoaded_;
    designData_ = other.designData_;
    for (int i = 0; i < kPageSlots; ++i)
        pageNames_[i] = other.pageNames_[i];
    ownsSpeedData_ = false;
    return *this;
}

Tsy_DCMwiz::~Tsy_DCMwiz()
{
    // Pages go first: they may still look at the speed data.
    DeletePages();
    if (ownsSpeedData_)
        delete speedData_;
}

int Tsy_DCMwiz::ConvertWizTypeStr(const StringBase& keyword)
{
    for (int i = 0; i < 8; ++i)
        if (keyword.Compare(kKeywords[i], Port::CompareNoCase) == 0)
            return i + 1;
    return TypeNone;
}

bool Tsy_DCMwiz::IsSingleDcmType(int wizType)
{
    return wizType != TypeBoardDeskew && wizType != TypeClockSwitching && wizType != TypeCascading;
}

bool Tsy_DCMwiz::IsTypeAvailable(int wizType)
{
    // The PLL designs need their PLL pages and generation, which this build
    // does not have yet.
    return wizType >= TypeDcm && wizType <= TypeCascading;
}

StringBase Tsy_DCMwiz::GetPageName(int slot) const
{
    return slot >= 0 && slot < kPageSlots ? pageNames_[slot] : StringBase();
}

bool Tsy_DCMwiz::InstantiatePages()
{
    designData_ = GetWizData();
    int count = 0;
    const Tsy_PageSlot* pageSet = Tsy_PageSetOf(wizType_, count);
    int slot = 0;
    for (int i = 0; i < count && slot < kPageSlots; ++i) {
        Tsy_DCMwizPage* page = Tsy_CreatePage(pageSet[i].kind, this, pageSet[i].instance);
        if (!page)
            continue;
        SetPage(slot, page);
        pageNames_[slot] = pageSet[i].name;
        ++slot;
    }
    LoadSpdFile(IsBatch());
    return true;
}

bool Tsy_DCMwiz::CustomizeGui(Gq_Wizard* wizard)
{
    if (wizard) {
        wizard->setCaption("Corvane Pendra");
        wizard->showMoreInfo(false);
        wizard->showAdvanced(false);
    }
    for (int i = 0; i < kPageSlots && GetPage(i); ++i) {
        Gq_WizardPage* gui = GetPage(i)->GetGui();
        if (!gui)
            continue;
        if (i > 0)
            gui->setPageBackName(q(pageNames_[i - 1]));
        bool last = i + 1 >= kPageSlots || !GetPage(i + 1);
        if (last) {
            gui->setPageNextName("Summary");
            if (GetSummaryPage())
                GetSummaryPage()->setPageBackName(q(pageNames_[i]));
        } else {
            gui->setPageNextName(q(pageNames_[i + 1]));
        }
        if (wizard) {
            wizard->addPage(gui);
            if (last && GetSummaryPage())
                wizard->addPage(GetSummaryPage());
        }
    }
    return true;
}

int Tsy_DCMwiz::Finish()
{
    return FinishDCMWiz() ? 0 : -1;
}

bool Tsy_DCMwiz::FinishDCMWiz()
{
    std::unique_ptr<Tsy_DesignGen> gen = Tsy_DesignGen::Create(this, wizType_);
    // Without a generator nothing can be built: that is a failed Finish, not
    // a finished design.
    if (!gen)
        return false;
    switch (wizType_) {
    case TypePll:
        return gen->GeneratePLLDesign();
    case TypeDcmToPll:
        return gen->GenerateDCMToPLLDesign();
    case TypePllToDcm:
        return gen->GeneratePLLToDCMDesign();
    default:
        return gen->GenerateDCMDesign();
    }
}

bool Tsy_DCMwiz::LoadSpdFile(bool batch)
{
    Tsy_Wait2Dlg wait;
    if (!batch) {
        wait.SetText("Loading data....");
        wait.Run();
    }
    bool result = false;
    if (!GetPartName().IsEmpty() && !speedData_) {
        speedData_ = new Tsy_SpeedData();
        speedData_->SetWizard(this);
        if (speedData_->Load(GetPartName())) {
            spdLoaded_ = true;
            result = true;
        } else {
            delete speedData_;
            speedData_ = nullptr;
            StringBase text("Error loading speedsfile for %1.");
            text.Arg(1, GetPartName());
            Tsy_WizPage::DoMessage(text, batch, GetStream(), true, GetMessageFlag(), false);
        }
    }
    if (!batch)
        wait.Quit();
    return result;
}

void Tsy_DCMwiz::reportMissing(const char* text) const
{
    Tsy_WizPage::DoMessage(text, IsBatch(), GetStream(), true, GetMessageFlag(), false);
}

Tsy_Block* Tsy_DCMwiz::GetActiveDCMBlk(int instNum, bool /*showMessage*/)
{
    if (!designData_)
        return nullptr;
    const bool single = IsSingleDcmType(wizType_);
    StringBase p = GetDCMPrimName();
    Tsy_Block* block = single ? designData_->GetActiveBlock(p) : designData_->GetActiveBlockInstNum(p, instNum);
    if (block)
        return block;
    int n = single ? 0 : instNum;
    if (p == "DCM_SP")
        if (Tsy_Block* converted = designData_->ConvertActiveBlk("DCM", p, n))
            return converted;
    if (Tsy_Block* converted = designData_->ConvertActiveBlk("DCM_SP", p, n))
        return converted;
    Tsy_Block* primitive = designData_->GetPrimitiveBlock(p);
    if (!primitive) {
        reportMissing("DCM block not found.");
        return nullptr;
    }
    if (single)
        return primitive;
    // Each DCM of a two-DCM wizard is its own copy, "DCM_ADV_INST2" for the
    // second DCM of a DCM_ADV family.
    Tsy_Block* copy = designData_->CopyBlock(primitive, StringBase::Printf("%s_INST%d", p.c_str(), instNum));
    if (!copy)
        return nullptr;
    copy->SetAttributeValue(Tsy_Attr::TESY_ONLY_INST_NUM, StringBase::Printf("%d", instNum));
    copy->active = true;
    return copy;
}

Tsy_Block* Tsy_DCMwiz::GetActivePLLBlk(bool showMessage)
{
    if (!designData_)
        return nullptr;
    if (Tsy_Block* block = designData_->GetActiveBlock("PLL_ADV"))
        return block;
    if (designData_->GetPrimitiveBlock("PLL_BASE"))
        if (Tsy_Block* converted = designData_->ConvertActiveBlk("PLL_BASE", "PLL_ADV", 0))
            return converted;
    if (Tsy_Block* primitive = designData_->GetPrimitiveBlock("PLL_ADV")) {
        primitive->active = true;
        return primitive;
    }
    if (showMessage)
        reportMissing("PLL block not found.");
    return nullptr;
}

Tsy_Block* Tsy_DCMwiz::GetActivePMCDBlk(int instNum)
{
    if (!designData_)
        return nullptr;
    Tsy_Block* block = instNum == 0 ? designData_->GetActiveBlock("PMCD") : designData_->GetBlockInstNum("PMCD", instNum);
    if (block)
        return block;
    Tsy_Block* primitive = designData_->GetPrimitiveBlock("PMCD");
    if (!primitive)
        return nullptr;
    if (instNum == 0) {
        primitive->active = true;
        return primitive;
    }
    if (instNum != 1 && instNum != 2) {
        primitive->active = false;
        return nullptr;
    }
    Tsy_Block* copy = designData_->CopyBlock(primitive, StringBase::Printf("PMCD_INST%d", instNum));
    if (!copy)
        return nullptr;
    copy->SetAttributeValue(Tsy_Attr::TESY_ONLY_INST_NUM, StringBase::Printf("%d", instNum));
    copy->active = true;
    primitive->active = false;
    return copy;
}

StringBase Tsy_DCMwiz::AddDCMPrefix(const StringBase& name, int which) const
{
    if (wizType_ == TypeDcm || wizType_ == TypeClockForwarding)
        return name;
    switch (which) {
    case 1: return StringBase::Printf("U1_%s", name.c_str());
    case 2: return StringBase::Printf("U2_%s", name.c_str());
    case 3: return StringBase::Printf("PLL_%s", name.c_str());
    default: return name;
    }
}

Tsy_Block* Tsy_DCMwiz::ResolveTarget(const StringBase& target, StringBase& reason)
{
    StringBase t = target;
    const bool pllType = wizType_ >= TypePll && wizType_ <= TypePllToDcm;
    auto refuse = [&](const char* why) -> Tsy_Block* {
        reason = why;
        return nullptr;
    };
    if (t.EqualsNoCase("dcm") || t.EqualsNoCase("dcm1") || t.EqualsNoCase("dcm2")) {
        int inst = t.EqualsNoCase("dcm2") ? 2 : 1;
        if (wizType_ == TypePll)
            return refuse("this wizard has no DCM");
        if (inst == 2 && IsSingleDcmType(wizType_))
            return refuse("this wizard has one DCM only (use dcm)");
        Tsy_Block* b = GetActiveDCMBlk(inst, true);
        return b ? b : refuse("the part has no DCM");
    }
    if (t.EqualsNoCase("pll")) {
        if (!pllType)
            return refuse("this wizard has no PLL");
        Tsy_Block* b = GetActivePLLBlk(true);
        return b ? b : refuse("the part has no PLL");
    }
    if (t.EqualsNoCase("pmcd") || t.EqualsNoCase("pmcd1") || t.EqualsNoCase("pmcd2")) {
        if (wizType_ != TypeDcm || !IsPmcdFamily())
            return refuse("this wizard has no PMCD");
        int inst = t.EqualsNoCase("pmcd") ? 0 : t.EqualsNoCase("pmcd1") ? 1 : 2;
        Tsy_Block* b = GetActivePMCDBlk(inst);
        return b ? b : refuse("the part has no PMCD");
    }
    return refuse("unknown target (use dcm, dcm2, pll, pmcd, pmcd1 or pmcd2)");
}

extern "C" Tsy_WizMain* pendra_create_wizard(const char* keyword, bool batch)
{
    int type = Tsy_DCMwiz::ConvertWizTypeStr(keyword ? keyword : "");
    if (!Tsy_DCMwiz::IsTypeAvailable(type))
        return nullptr;
    return new Tsy_DCMwiz(keyword, batch);
}
