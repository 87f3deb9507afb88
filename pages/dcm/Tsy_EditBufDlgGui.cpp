#include "pages/dcm/Tsy_EditBufDlgGui.h"

#include "Tsy_EditBufDlgUI_Imp.h"
#include "pages/dcm/Tsy_BufferEdit.h"
#include "pages/dcm/Tsy_BufferRecords.h"
#include "pages/dcm/Tsy_ClockBufDlg.h"
#include "pages/dcm/Tsy_ClockBufDlgGui.h"
#include "wizard/Tsy_DCMwiz.h"

#include <QComboBox>
#include <QKeySequence>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QShortcut>
#include <QVBoxLayout>

namespace Rec = Tsy_BufferRecords;

namespace {

QString q(const StringBase& s)
{
    return QString::fromStdString(s.str());
}

StringBase s(const QString& text)
{
    return StringBase(text.toStdString());
}

} // namespace

Tsy_EditBufDlgGui::Tsy_EditBufDlgGui(Tsy_BufferEdit& editor, Tsy_ClockBufDlgGui* owner, QWidget* parent)
    : Gq_Dialog(parent), editor_(editor), owner_(owner)
{
    setObjectName("Tsy_EditBufDlgGui");
    setWindowTitle("Corvane Pendra - View/Edit Buffer");
    setModal(true);
    form_ = new Tsy_EditBufDlgUI_Imp(this);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(form_);
    form_->PushButtonOk->setDefault(true);

    connect(form_->PushButtonOk, &QPushButton::clicked, this, &Tsy_EditBufDlgGui::onOk);
    connect(form_->PushButtonCancel, &QPushButton::clicked, this, &Tsy_EditBufDlgGui::onCancel);
    connect(form_->PushButtonDelete, &QPushButton::clicked, this, &Tsy_EditBufDlgGui::OnButtonDelete);
    connect(form_->PushButtonMoreInfo, &QPushButton::clicked, this, &Tsy_EditBufDlgGui::onMoreInfo);
    connect(form_->ComboBoxI0, qOverload<int>(&QComboBox::activated), this, &Tsy_EditBufDlgGui::OnComboBoxI0);
    connect(form_->ComboBoxI1, qOverload<int>(&QComboBox::activated), this, &Tsy_EditBufDlgGui::OnComboBoxI1);
    connect(form_->ComboBoxIgnore0, qOverload<int>(&QComboBox::activated), this, &Tsy_EditBufDlgGui::OnComboBoxIgnore0);
    connect(form_->ComboBoxIgnore1, qOverload<int>(&QComboBox::activated), this, &Tsy_EditBufDlgGui::OnComboBoxIgnore1);
    connect(form_->RadioButtonBufg, &QRadioButton::clicked, this, &Tsy_EditBufDlgGui::OnRadioBufg);
    connect(form_->RadioButtonBufgce, &QRadioButton::clicked, this, &Tsy_EditBufDlgGui::OnRadioBufgce);
    connect(form_->RadioButtonBufgmux, &QRadioButton::clicked, this, &Tsy_EditBufDlgGui::OnRadioBufgmux);
    connect(form_->RadioButtonBufgctrl, &QRadioButton::clicked, this, &Tsy_EditBufDlgGui::OnRadioBufgctrl);
    connect(form_->RadioButtonBufgmuxTal4, &QRadioButton::clicked, this, &Tsy_EditBufDlgGui::OnRadioBufgmuxT4);
    connect(form_->RadioButtonLocalRouting, &QRadioButton::clicked, this, &Tsy_EditBufDlgGui::OnRadioLocalRouting);
    connect(form_->RadioButtonLowskewline, &QRadioButton::clicked, this, &Tsy_EditBufDlgGui::OnRadioLowskewline);
    connect(form_->LineEditO, &QLineEdit::textChanged, this, &Tsy_EditBufDlgGui::OnEditOutputSig);

    // The other port names take what is typed as it is typed.
    const std::pair<QLineEdit*, Tsy_BufferEdit::Slot> names[] = {{form_->LineEditS0, Tsy_BufferEdit::SlotS},
                                                                 {form_->LineEditS1, Tsy_BufferEdit::SlotS1},
                                                                 {form_->LineEditCE0, Tsy_BufferEdit::SlotCE},
                                                                 {form_->LineEditCE1, Tsy_BufferEdit::SlotCE1},
                                                                 {form_->LineEditIgnore0, Tsy_BufferEdit::SlotIgnore0},
                                                                 {form_->LineEditIgnore1, Tsy_BufferEdit::SlotIgnore1}};
    for (const auto& n : names) {
        Tsy_BufferEdit::Slot slot = n.second;
        connect(n.first, &QLineEdit::textEdited, this, [this, slot](const QString& text) {
            if (!guard_)
                editor_.SetSignalName(slot, s(text));
        });
    }
    // "&Local &Routing" underlines R as well.
    auto* routing = new QShortcut(QKeySequence(Qt::ALT | Qt::Key_R), this);
    connect(routing, &QShortcut::activated, this, [this] {
        if (form_->RadioButtonLocalRouting->isEnabled())
            form_->RadioButtonLocalRouting->click();
    });
}

Tsy_EditBufDlgGui::~Tsy_EditBufDlgGui() = default;

QString Tsy_EditBufDlgGui::PictureName() const
{
    return form_->pictureName();
}

QImage Tsy_EditBufDlgGui::Picture() const
{
    return form_->picture();
}

void Tsy_EditBufDlgGui::issue(const char* text)
{
    if (owner_ && owner_->LogicalPage())
        owner_->LogicalPage()->IssueMessage(text, false, false, false);
}

int Tsy_EditBufDlgGui::exec()
{
    onActive();
    firstControl();
    return Gq_Dialog::exec() == QDialog::Accepted ? 1 : 0;
}

void Tsy_EditBufDlgGui::firstControl()
{
    if (editor_.IsNewBuffer())
        form_->ComboBoxI0->setFocus();
    else if (QRadioButton* r = radioOf(q(editor_.GetType())); r && r->isEnabled())
        r->setFocus();
    else
        form_->PushButtonOk->setFocus();
}

void Tsy_EditBufDlgGui::onActive()
{
    guard_ = true;
    const Tsy_DCMwiz* wiz = owner_ && owner_->LogicalPage() ? owner_->LogicalPage()->GetDCMWiz() : nullptr;
    const bool taldor5 = wiz && wiz->GetFamilyName().EqualsNoCase("taldor5");
    form_->RadioButtonBufgmuxTal4->setText(taldor5 ? "Global Clock Mux" : "Clock Mux for &Taldor4");
    // The label has no letter of its own there; the key stays the same.
    form_->RadioButtonBufgmuxTal4->setShortcut(QKeySequence(Qt::ALT | Qt::Key_T));
    form_->PushButtonDelete->setEnabled(true);
    fillInputs();
    restrictChoices();
    selectTypeRadio();
    enableForType();
    fillNames();
    showPicture();
    guard_ = false;
}

QRadioButton* Tsy_EditBufDlgGui::radioOf(const QString& type) const
{
    if (type.compare("BUFG", Qt::CaseInsensitive) == 0)
        return form_->RadioButtonBufg;
    if (type.compare("BUFGCE", Qt::CaseInsensitive) == 0)
        return form_->RadioButtonBufgce;
    if (type.compare("BUFGMUX", Qt::CaseInsensitive) == 0)
        return form_->RadioButtonBufgmux;
    if (type.compare("BUFGCTRL", Qt::CaseInsensitive) == 0)
        return form_->RadioButtonBufgctrl;
    if (type.compare("BUFGMUX_CTRL", Qt::CaseInsensitive) == 0 ||
        type.compare("BUFGMUX_TALDOR4", Qt::CaseInsensitive) == 0)
        return form_->RadioButtonBufgmuxTal4;
    if (type.compare("LOCALROUTING", Qt::CaseInsensitive) == 0)
        return form_->RadioButtonLocalRouting;
    if (type.compare("LOWSKEWLINE", Qt::CaseInsensitive) == 0)
        return form_->RadioButtonLowskewline;
    return nullptr;
}

void Tsy_EditBufDlgGui::selectTypeRadio()
{
    QRadioButton* all[] = {form_->RadioButtonBufg,       form_->RadioButtonBufgce,      form_->RadioButtonBufgmux,
                           form_->RadioButtonBufgctrl,   form_->RadioButtonBufgmuxTal4, form_->RadioButtonLocalRouting,
                           form_->RadioButtonLowskewline};
    QRadioButton* chosen = radioOf(q(editor_.GetType()));
    // A type without a button (an output buffer another page chose) leaves
    // every button clear.
    for (QRadioButton* r : all) {
        r->setAutoExclusive(false);
        r->setChecked(r == chosen);
        r->setAutoExclusive(true);
    }
}

void Tsy_EditBufDlgGui::restrictChoices()
{
    const Tsy_DCMwiz* wiz = owner_ && owner_->LogicalPage() ? owner_->LogicalPage()->GetDCMWiz() : nullptr;
    const bool ctrlFamily = wiz && wiz->IsBufgctrlFamily();
    const bool taldor5 = wiz && wiz->GetFamilyName().EqualsNoCase("taldor5");
    form_->RadioButtonBufg->setEnabled(true);
    form_->RadioButtonBufgce->setEnabled(true);
    form_->RadioButtonBufgmux->setEnabled(true);
    form_->RadioButtonBufgctrl->setEnabled(ctrlFamily);
    form_->RadioButtonBufgmuxTal4->setEnabled(ctrlFamily);
    form_->RadioButtonLocalRouting->setEnabled(!taldor5);
    form_->RadioButtonLowskewline->setEnabled(false);
}

void Tsy_EditBufDlgGui::fillInputs()
{
    QComboBox* i0 = form_->ComboBoxI0;
    QComboBox* i1 = form_->ComboBoxI1;
    i0->clear();
    i1->clear();
    i1->addItem("NONE");
    if (editor_.IsNewBuffer()) {
        i0->addItem("NONE");
        for (const StringBase& o : editor_.GetOutputs())
            i0->addItem(q(o));
    } else {
        i0->addItem(q(editor_.GetI0()));
    }
    for (const StringBase& o : editor_.GetOutputs())
        i1->addItem(q(o));
    // An I1 source that is no longer listed still shows what is recorded.
    if (!editor_.GetI1().IsEmpty() && i1->findText(q(editor_.GetI1())) < 0)
        i1->addItem(q(editor_.GetI1()));
    i0->setCurrentIndex(std::max(0, i0->findText(q(editor_.GetI0()))));
    i1->setCurrentIndex(std::max(0, i1->findText(q(editor_.GetI1()))));
    i0->setEnabled(editor_.IsNewBuffer());
    form_->ComboBoxIgnore0->setCurrentIndex(
        std::max(0, form_->ComboBoxIgnore0->findText(q(editor_.GetIgnoreChoice(0)))));
    form_->ComboBoxIgnore1->setCurrentIndex(
        std::max(0, form_->ComboBoxIgnore1->findText(q(editor_.GetIgnoreChoice(1)))));
    form_->GroupBoxBufferType->setTitle(q(editor_.GroupTitle()));

    // Parallel PMCDs: say which PMCD each input comes from.
    const bool parallel = editor_.IsParallelPmcd();
    form_->TextLabelFromInst1->setVisible(parallel);
    form_->TextLabelFromInst2->setVisible(parallel);
    if (parallel) {
        int inst = 1;
        Tsy_BufferEdit::PinNameOf(editor_.GetI0(), 1, &inst);
        form_->TextLabelFromInst1->setText(QString("From INST%1").arg(inst));
        inst = 1;
        Tsy_BufferEdit::PinNameOf(editor_.GetI1(), 1, &inst);
        form_->TextLabelFromInst2->setText(QString("From INST%1").arg(inst));
    }
}

void Tsy_EditBufDlgGui::enableForType()
{
    const StringBase type = editor_.GetType();
    auto has = [&](Tsy_BufferEdit::Slot slot) { return Tsy_BufferEdit::HasSlot(type, slot); };
    const bool ctrl = type.EqualsNoCase("BUFGCTRL");
    const bool mux = Rec::IsMuxType(type);

    form_->TextLabelI0->setText(mux ? "I0:" : "I:");
    form_->LineEditI0Sig->setEnabled(has(Tsy_BufferEdit::SlotIn));
    form_->TextLabelI1->setEnabled(mux);
    form_->ComboBoxI1->setEnabled(mux);
    form_->LineEditI1Sig->setEnabled(mux);
    form_->TextLabelFromInst2->setEnabled(mux);
    form_->TextLabelS0->setText(ctrl ? "S0:" : "S:");
    form_->TextLabelCE0->setText(ctrl ? "CE0:" : "CE:");

    struct Field {
        QLabel* label;
        QWidget* edit;
        Tsy_BufferEdit::Slot slot;
    };
    const Field fields[] = {
        {form_->TextLabelS0, form_->LineEditS0, Tsy_BufferEdit::SlotS},
        {form_->TextLabelS1, form_->LineEditS1, Tsy_BufferEdit::SlotS1},
        {form_->TextLabelCE0, form_->LineEditCE0, Tsy_BufferEdit::SlotCE},
        {form_->TextLabelCE1, form_->LineEditCE1, Tsy_BufferEdit::SlotCE1},
        {form_->TextLabelIgnore0, form_->ComboBoxIgnore0, Tsy_BufferEdit::SlotIgnore0},
        {form_->TextLabelIgnore1, form_->ComboBoxIgnore1, Tsy_BufferEdit::SlotIgnore1},
        {form_->TextLabelO, form_->LineEditO, Tsy_BufferEdit::SlotO},
    };
    for (const Field& f : fields) {
        f.label->setEnabled(has(f.slot));
        f.edit->setEnabled(has(f.slot));
    }
    form_->LineEditIgnore0->setEnabled(has(Tsy_BufferEdit::SlotIgnore0) &&
                                       editor_.GetIgnoreChoice(0).EqualsNoCase(Tsy_BufferEdit::kIgnoreSignal));
    form_->LineEditIgnore1->setEnabled(has(Tsy_BufferEdit::SlotIgnore1) &&
                                       editor_.GetIgnoreChoice(1).EqualsNoCase(Tsy_BufferEdit::kIgnoreSignal));
}

// Port fields show the name the buffer will use: the given one, or the
// default that follows I0, I1 and the type.
void Tsy_EditBufDlgGui::fillNames()
{
    const bool was = guard_;
    guard_ = true;
    const std::pair<QLineEdit*, Tsy_BufferEdit::Slot> fields[] = {{form_->LineEditI0Sig, Tsy_BufferEdit::SlotIn},
                                                                  {form_->LineEditI1Sig, Tsy_BufferEdit::SlotI1},
                                                                  {form_->LineEditS0, Tsy_BufferEdit::SlotS},
                                                                  {form_->LineEditS1, Tsy_BufferEdit::SlotS1},
                                                                  {form_->LineEditCE0, Tsy_BufferEdit::SlotCE},
                                                                  {form_->LineEditCE1, Tsy_BufferEdit::SlotCE1},
                                                                  {form_->LineEditIgnore0, Tsy_BufferEdit::SlotIgnore0},
                                                                  {form_->LineEditIgnore1, Tsy_BufferEdit::SlotIgnore1},
                                                                  {form_->LineEditO, Tsy_BufferEdit::SlotO}};
    const StringBase type = editor_.GetType();
    for (const auto& f : fields) {
        bool used = Tsy_BufferEdit::HasSlot(type, f.second);
        // A port the type does not have shows no name rather than a stale one.
        f.first->setText(used ? q(editor_.GetSignalName(f.second)) : QString());
    }
    guard_ = was;
}

void Tsy_EditBufDlgGui::showPicture()
{
    QString name = q(Rec::PictureName(editor_.GetType()));
    if (form_->setPicture(name))
        return;
    issue("Unable to load requested bitmap.  Loading default.");
    form_->setPicture("bufg");
}

void Tsy_EditBufDlgGui::readForm()
{
    if (editor_.IsNewBuffer())
        editor_.SetI0(s(form_->ComboBoxI0->currentText()));
    if (Rec::IsMuxType(editor_.GetType()))
        editor_.SetI1(s(form_->ComboBoxI1->currentText()));
    editor_.SetIgnoreChoice(0, s(form_->ComboBoxIgnore0->currentText()));
    editor_.SetIgnoreChoice(1, s(form_->ComboBoxIgnore1->currentText()));
    const std::pair<QLineEdit*, Tsy_BufferEdit::Slot> fields[] = {{form_->LineEditS0, Tsy_BufferEdit::SlotS},
                                                                  {form_->LineEditS1, Tsy_BufferEdit::SlotS1},
                                                                  {form_->LineEditCE0, Tsy_BufferEdit::SlotCE},
                                                                  {form_->LineEditCE1, Tsy_BufferEdit::SlotCE1},
                                                                  {form_->LineEditIgnore0, Tsy_BufferEdit::SlotIgnore0},
                                                                  {form_->LineEditIgnore1, Tsy_BufferEdit::SlotIgnore1},
                                                                  {form_->LineEditO, Tsy_BufferEdit::SlotO}};
    for (const auto& f : fields)
        if (f.first->isEnabled())
            editor_.SetSignalName(f.second, s(f.first->text()));
}

void Tsy_EditBufDlgGui::onCancel()
{
    reject();
}

void Tsy_EditBufDlgGui::onOk()
{
    readForm();
    if (editor_.Ok())
        accept();
    else
        fillNames();
}

void Tsy_EditBufDlgGui::onMoreInfo()
{
    if (owner_ && owner_->LogicalPage())
        owner_->LogicalPage()->InvokeMoreInfo("tsy_dcmeditbuf");
}

void Tsy_EditBufDlgGui::OnButtonDelete()
{
    readForm();
    if (editor_.Delete()) {
        accept();
        return;
    }
    // Refused: the type goes back to what the buffer had.
    guard_ = true;
    selectTypeRadio();
    enableForType();
    fillNames();
    showPicture();
    guard_ = false;
}

void Tsy_EditBufDlgGui::OnComboBoxI0()
{
    if (guard_)
        return;
    editor_.SetI0(s(form_->ComboBoxI0->currentText()));
    fillInputs();
    fillNames();
}

void Tsy_EditBufDlgGui::OnComboBoxI1()
{
    if (guard_)
        return;
    editor_.SetI1(s(form_->ComboBoxI1->currentText()));
    fillInputs();
    fillNames();
}

void Tsy_EditBufDlgGui::OnComboBoxIgnore0()
{
    if (guard_)
        return;
    editor_.SetIgnoreChoice(0, s(form_->ComboBoxIgnore0->currentText()));
    enableForType();
}

void Tsy_EditBufDlgGui::OnComboBoxIgnore1()
{
    if (guard_)
        return;
    editor_.SetIgnoreChoice(1, s(form_->ComboBoxIgnore1->currentText()));
    enableForType();
}

void Tsy_EditBufDlgGui::chooseType(const char* type)
{
    if (guard_)
        return;
    // Names typed so far stay with the dialog while the type changes.
    readForm();
    editor_.SetType(type);
    guard_ = true;
    selectTypeRadio();
    enableForType();
    fillNames();
    showPicture();
    guard_ = false;
}

void Tsy_EditBufDlgGui::OnRadioBufg()
{
    chooseType("BUFG");
}

void Tsy_EditBufDlgGui::OnRadioBufgce()
{
    chooseType("BUFGCE");
}

void Tsy_EditBufDlgGui::OnRadioBufgmux()
{
    chooseType("BUFGMUX");
}

void Tsy_EditBufDlgGui::OnRadioBufgctrl()
{
    chooseType("BUFGCTRL");
}

void Tsy_EditBufDlgGui::OnRadioBufgmuxT4()
{
    const Tsy_DCMwiz* wiz = owner_ && owner_->LogicalPage() ? owner_->LogicalPage()->GetDCMWiz() : nullptr;
    chooseType(wiz && wiz->IsBufgmuxCtrlFamily() ? "BUFGMUX_CTRL" : "BUFGMUX_TALDOR4");
}

void Tsy_EditBufDlgGui::OnRadioLocalRouting()
{
    chooseType("LOCALROUTING");
}

void Tsy_EditBufDlgGui::OnRadioLowskewline()
{
    chooseType("LOWSKEWLINE");
}

void Tsy_EditBufDlgGui::OnEditOutputSig()
{
    if (!guard_)
        editor_.SetSignalName(Tsy_BufferEdit::SlotO, s(form_->LineEditO->text()));
}
