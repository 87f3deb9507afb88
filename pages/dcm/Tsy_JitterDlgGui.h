#pragma once
// The controller of the Clock Frequency Synthesizer page: copies between the
// form and the page's settings and reacts to the form's buttons.

#include "gui/Gq_WizardPage.h"

class QWidget;
class Tsy_JitterDlg;
class Tsy_JitterDlgUI;

class Tsy_JitterDlgGui : public Gq_WizardPage {
    Q_OBJECT
public:
    // Without a form (batch mode) the controller only forwards to the page.
    Tsy_JitterDlgGui(Tsy_JitterDlg* page, QWidget* parent, bool withForm);
    ~Tsy_JitterDlgGui() override;

    Tsy_JitterDlgUI* form() const { return form_; }

    void onActive() override;
    void dataToWidgets() override;
    void widgetsToData() override;
    bool onNext() override;
    bool onBack() override;
    void onMoreInfo() override;

public slots:
    void OnRadioInputType();
    void OnRadioFoutMhzUnits();
    void OnRadioFoutNsUnits();
    void OnButtonCalculate();

private:
    void readTexts();
    void changeUnits(int units);
    void showResults();

    Tsy_JitterDlg* page_;
    Tsy_JitterDlgUI* form_ = nullptr;
    // Set while the controller writes the form, so its own changes do not
    // come back as user actions.
    bool writing_ = false;
};
