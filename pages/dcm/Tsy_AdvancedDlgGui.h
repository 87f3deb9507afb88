#pragma once
// The Advanced dialog of General Setup. It works on a copy of the page's less
// common settings; only OK hands them back.

#include "gui/Gq_Dialog.h"
#include "port/StringBase.h"

class Tsy_AdvancedDlgUI;
class Tsy_DCMgenSetup;

class Tsy_AdvancedDlgGui : public Gq_Dialog {
    Q_OBJECT
public:
    Tsy_AdvancedDlgGui(Tsy_DCMgenSetup* page, QWidget* parent = nullptr);
    ~Tsy_AdvancedDlgGui() override;

    // Copies the page's settings in and applies the reset-logic and family
    // rules to the form.
    void LoadFromPage();
    // Hands the settings to the page; true when the input divider or the
    // performance mode changed, so the page's frequency figures are stale.
    bool StoreToPage() const;

    Tsy_AdvancedDlgUI* form() const { return form_; }

    StringBase deskewAdjust = "SYSTEM_SYNCHRONOUS";
    bool startupWait = false;
    bool divideBy2 = false;
    bool resetLogic = false;
    bool resetLogicAvailable = true;
    bool reconfigPins = false;
    bool maxRange = false;

public slots:
    void onOk();
    void onCancel();
    void onMoreInfo();

private:
    void readWidgets();
    void writeWidgets();

    Tsy_DCMgenSetup* page_;
    Tsy_AdvancedDlgUI* form_;
};
