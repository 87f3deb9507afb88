#pragma once
// The View/Edit Buffer dialog. It shows one buffer of the Clock Buffers page
// (held by the page's buffer editor), lets the user change its type, inputs
// and signal names, and on OK has the editor write the records.

#include "gui/Gq_Dialog.h"

#include <QImage>
#include <QString>

class QComboBox;
class QLabel;
class QLineEdit;
class QRadioButton;
class Tsy_BufferEdit;
class Tsy_ClockBufDlgGui;
class Tsy_EditBufDlgUI_Imp;

class Tsy_EditBufDlgGui : public Gq_Dialog {
    Q_OBJECT
public:
    Tsy_EditBufDlgGui(Tsy_BufferEdit& editor, Tsy_ClockBufDlgGui* owner, QWidget* parent);
    ~Tsy_EditBufDlgGui() override;

    Tsy_EditBufDlgUI_Imp* Form() const { return form_; }
    // The buffer picture shown now, by its registry name, and as painted.
    QString PictureName() const;
    QImage Picture() const;

public slots:
    void firstControl();
    // Fills the form from the editor and runs the dialog; 1 for OK.
    int exec() override;
    void onActive();
    void onCancel();
    void onOk();
    void onMoreInfo();
    void OnButtonDelete();
    void OnComboBoxI0();
    void OnComboBoxI1();
    void OnComboBoxIgnore0();
    void OnComboBoxIgnore1();
    void OnRadioBufg();
    void OnRadioBufgce();
    void OnRadioBufgmux();
    void OnRadioBufgctrl();
    void OnRadioBufgmuxT4();
    void OnRadioLocalRouting();
    void OnRadioLowskewline();
    void OnEditOutputSig();

private:
    void chooseType(const char* type);
    void selectTypeRadio();
    void restrictChoices();
    void enableForType();
    void fillNames();
    void fillInputs();
    void readForm();
    void showPicture();
    QRadioButton* radioOf(const QString& type) const;
    void issue(const char* text);

    Tsy_BufferEdit& editor_;
    Tsy_ClockBufDlgGui* owner_;
    Tsy_EditBufDlgUI_Imp* form_;
    bool guard_ = false;
};
