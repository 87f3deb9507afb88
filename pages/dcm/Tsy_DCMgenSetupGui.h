#pragma once
// The General Setup page in the wizard window: copies between the form and
// the page's settings, keeps the form's rules and reacts to its controls.

#include "gui/Gq_WizardPage.h"
#include "port/StringBase.h"

#include <QPointer>

class QWidget;
class Tsy_DCMgenSetup;
class Tsy_DCMgenSetupUI_Imp;

class Tsy_DCMgenSetupGui : public Gq_WizardPage {
    Q_OBJECT
public:
    Tsy_DCMgenSetupGui(Tsy_DCMgenSetup* page, QWidget* parent);
    ~Tsy_DCMgenSetupGui() override;

    void onActive() override;
    void dataToWidgets() override { ApplyToGui(); }
    void widgetsToData() override { ReadFromGui(); }
    bool onNext() override;
    bool onBack() override;
    void onAdvanced() override;
    void onMoreInfo() override;

    // The form into the page's settings, and back.
    void ReadFromGui();
    void ApplyToGui();

    Tsy_DCMgenSetupUI_Imp* form() const;
    Tsy_DCMgenSetup* page() const { return page_; }

public slots:
    void OnChangeCLKIN();
    void OnChangeFeedback();
    void OnChangeFIN();
    void OnChangePStype();
    void OnChangeRST();
    void OnChangeClkout();
    void OnChangePMCD();
    void OnChangePSvalue();

private:
    void connectForm();
    // The input frequency, the outputs or an Advanced setting changed: the
    // frequency modes, the phase-shift rules and limits follow.
    void recompute(bool warn);
    // ApplyToGui's steps, in the order it takes them.
    bool isOutputForced(int pin, const StringBase& feedback) const;
    void forceRequiredPins(const StringBase& feedback);
    void applyInputFrequency();
    void applyInputSource();
    void applyFeedback();
    void applyPinBoxes(const StringBase& feedback);
    void applyOutputOptions();
    void applySymbol();
    void applyPhaseShift();
    bool isRstForced() const;
    bool isRstBlocked() const;

    Tsy_DCMgenSetup* page_;
    QPointer<Tsy_DCMgenSetupUI_Imp> form_;
    // The value box shows the set value held to the current limits; the set
    // value itself survives limits that narrow for a moment while the user
    // types a frequency, and is replaced only by what the user picks.
    int shownPsValue() const;
    void takeShownPsValue();

    bool updating_ = false;
    bool phaseShiftHeld_ = false;
    int shownPs_ = 0;
};
