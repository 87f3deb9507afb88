#include "gui/Gq_StartDialog.h"

#include "hdl/Tsy_HdlNames.h"
#include "lib/Tsy_DataDir.h"
#include "lib/Tsy_DeviceCatalog.h"

#include <QComboBox>
#include <QCompleter>
#include <QDialogButtonBox>
#include <QFileDialog>
#include <QFormLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

#include <exception>

namespace {

QLabel* makeNote(QWidget* parent, const char* name)
{
    auto* note = new QLabel(parent);
    note->setObjectName(name);
    note->setTextFormat(Qt::PlainText);
    note->setWordWrap(true);
    QPalette pal = note->palette();
    pal.setColor(QPalette::WindowText, QColor(0xb0, 0x10, 0x10));
    note->setPalette(pal);
    note->hide();
    return note;
}

QLabel* buddyLabel(QWidget* parent, const char* text, QWidget* buddy)
{
    auto* label = new QLabel(text, parent);
    label->setBuddy(buddy);
    return label;
}

// Completes on a match anywhere in a word, in any case.
QCompleter* anywhereCompleter(const QStringList& words, QObject* parent)
{
    auto* completer = new QCompleter(words, parent);
    completer->setCaseSensitivity(Qt::CaseInsensitive);
    completer->setFilterMode(Qt::MatchContains);
    completer->setCompletionMode(QCompleter::PopupCompletion);
    return completer;
}

void showNote(QLabel* note, const QString& text)
{
    note->setText(text);
    note->setVisible(!text.isEmpty());
}

} // namespace

Gq_StartDialog::Gq_StartDialog(const Tsy_WizardCatalog& wizards, const Tsy_DeviceCatalog& devices, QWidget* parent)
    : Gq_Dialog(parent), wizards_(wizards.Wizards()), devices_(devices)
{
    setObjectName("StartDialog");
    setWindowTitle("Corvane Pendra - New Design");
    makeWizardChoice();
    makePartChoice();
    makeModuleField();
    makeFolderField();
    makeNotes();
    layOutDialog();
    connectFields();
    revalidate();
}

void Gq_StartDialog::makeWizardChoice()
{
    wizard_ = new QComboBox(this);
    wizard_->setObjectName("ComboWizard");
    for (const auto& w : wizards_) {
        QString key = QString::fromStdString(w.key);
        QString text = w.description.empty() ? key : key + " - " + QString::fromStdString(w.description);
        wizard_->addItem(text, key);
    }
    int dcm = wizard_->findData("dcm");
    if (dcm >= 0)
        wizard_->setCurrentIndex(dcm);
}

void Gq_StartDialog::makePartChoice()
{
    part_ = new QComboBox(this);
    part_->setObjectName("ComboPart");
    part_->setEditable(true);
    part_->setInsertPolicy(QComboBox::NoInsert);
    QStringList parts;
    for (const auto& p : devices_.Parts())
        parts << QString::fromStdString(p.part);
    part_->addItems(parts);
    // Part names are long and alike: any piece of one finds it.
    part_->setCompleter(anywhereCompleter(parts, part_));
    if (!parts.isEmpty())
        part_->setCurrentIndex(0);
}

void Gq_StartDialog::makeModuleField()
{
    module_ = new QLineEdit("clkgen", this);
    module_->setObjectName("LineEditModule");
    module_->setToolTip("The name of the generated HDL module; it must be legal in both Verilog and VHDL.");
}

void Gq_StartDialog::makeFolderField()
{
    folder_ = new QLineEdit(".", this);
    folder_->setObjectName("LineEditFolder");
    folder_->setToolTip("The folder that Finish writes the design and HDL files into.");
    browse_ = new QPushButton("&Browse...", this);
    browse_->setObjectName("PushButtonBrowse");
    browse_->setAutoDefault(false);
}

void Gq_StartDialog::makeNotes()
{
    partNote_ = makeNote(this, "TextLabelPartProblem");
    moduleNote_ = makeNote(this, "TextLabelModuleProblem");
    folderNote_ = makeNote(this, "TextLabelFolderProblem");
}

// Each field with its label, and under it the note that says what is wrong
// with it.
QFormLayout* Gq_StartDialog::fieldForm()
{
    auto* folderRow = new QHBoxLayout;
    folderRow->addWidget(folder_, 1);
    folderRow->addWidget(browse_);

    auto* form = new QFormLayout;
    form->addRow(buddyLabel(this, "&Wizard type:", wizard_), wizard_);
    form->addRow(buddyLabel(this, "&Part:", part_), part_);
    form->addRow(QString(), partNote_);
    form->addRow(buddyLabel(this, "&Module name:", module_), module_);
    form->addRow(QString(), moduleNote_);
    form->addRow(buddyLabel(this, "Output &folder:", folder_), folderRow);
    form->addRow(QString(), folderNote_);
    return form;
}

QDialogButtonBox* Gq_StartDialog::makeButtonBox()
{
    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    ok_ = buttons->button(QDialogButtonBox::Ok);
    ok_->setText("&OK");
    ok_->setDefault(true);
    buttons->button(QDialogButtonBox::Cancel)->setText("&Cancel");
    connect(buttons, &QDialogButtonBox::accepted, this, [this] {
        if (problem().isEmpty())
            accept();
    });
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    return buttons;
}

void Gq_StartDialog::layOutDialog()
{
    QFormLayout* form = fieldForm();
    QDialogButtonBox* buttons = makeButtonBox();
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(form);
    layout->addStretch(1);
    layout->addWidget(buttons);
    setMinimumWidth(480);
}

void Gq_StartDialog::connectFields()
{
    connect(wizard_, &QComboBox::currentIndexChanged, this, [this] { revalidate(); });
    connect(part_, &QComboBox::currentTextChanged, this, [this] { revalidate(); });
    connect(module_, &QLineEdit::textChanged, this, [this] { revalidate(); });
    connect(folder_, &QLineEdit::textChanged, this, [this] { revalidate(); });
    connect(browse_, &QPushButton::clicked, this, [this] { browse(); });
}

Gq_StartDialog::~Gq_StartDialog() = default;

std::unique_ptr<Gq_StartDialog> Gq_StartDialog::fromDataDir(QString& error, QWidget* parent)
{
    try {
        auto wizards = Tsy_WizardCatalog::LoadFile(Tsy_DataFile("wizards.json"));
        const Tsy_DeviceCatalog& devices = Tsy_DeviceCatalog::Instance();
        return std::make_unique<Gq_StartDialog>(*wizards, devices, parent);
    } catch (const std::exception& e) {
        error = QString::fromStdString(e.what());
        return nullptr;
    }
}

QString Gq_StartDialog::wizardKey() const
{
    return wizard_->currentData().toString();
}

QString Gq_StartDialog::part() const
{
    QString typed = part_->currentText().trimmed();
    Tsy_PartInfo info;
    if (devices_.FindPart(typed.toStdString(), info))
        return QString::fromStdString(info.part);
    return typed;
}

QString Gq_StartDialog::moduleName() const
{
    return module_->text().trimmed();
}

QString Gq_StartDialog::outputFolder() const
{
    return folder_->text().trimmed();
}

void Gq_StartDialog::setWizardKey(const QString& key)
{
    for (int i = 0; i < wizard_->count(); ++i)
        if (wizard_->itemData(i).toString().compare(key, Qt::CaseInsensitive) == 0)
            wizard_->setCurrentIndex(i);
}

void Gq_StartDialog::setPart(const QString& part)
{
    part_->setEditText(part);
}

void Gq_StartDialog::setModuleName(const QString& name)
{
    module_->setText(name);
}

void Gq_StartDialog::setOutputFolder(const QString& folder)
{
    folder_->setText(folder);
}

QString Gq_StartDialog::partProblem() const
{
    QString typed = part_->currentText().trimmed();
    if (typed.isEmpty())
        return "Choose a part.";
    Tsy_PartInfo info;
    if (!devices_.FindPart(typed.toStdString(), info))
        return QString("There is no part named %1; choose one from the list.").arg(typed);
    int index = wizard_->currentIndex();
    if (index >= 0 && index < static_cast<int>(wizards_.size()) && info.family) {
        std::string missing = Tsy_WizardCatalog::MissingCapability(wizards_[index], *info.family);
        if (!missing.empty())
            return QString("The %1 family of part %2 cannot build this wizard (it has no %3).")
                .arg(QString::fromStdString(info.family->name), QString::fromStdString(info.part),
                     QString::fromStdString(missing));
    }
    return QString();
}

QString Gq_StartDialog::problem() const
{
    if (wizard_->currentIndex() < 0)
        return "There is no wizard to choose.";
    QString p = partProblem();
    if (!p.isEmpty())
        return p;
    std::string why = Tsy_HdlNameProblem(moduleName().toStdString());
    if (!why.empty())
        return QString("The module name is not a legal Verilog and VHDL name: it %1.").arg(QString::fromStdString(why));
    if (outputFolder().isEmpty())
        return "Choose the folder to write the design into.";
    return QString();
}

void Gq_StartDialog::revalidate()
{
    showNote(partNote_, partProblem());
    std::string why = Tsy_HdlNameProblem(moduleName().toStdString());
    showNote(moduleNote_, why.empty() ? QString()
                                      : QString("Not a legal Verilog and VHDL name: it %1.")
                                            .arg(QString::fromStdString(why)));
    showNote(folderNote_, outputFolder().isEmpty() ? QString("Choose the folder to write the design into.")
                                                   : QString());
    ok_->setEnabled(problem().isEmpty());
}

void Gq_StartDialog::browse()
{
    QFileDialog dialog(this, "Corvane Pendra - Output Folder", outputFolder());
    dialog.setObjectName("OutputFolderDialog");
    dialog.setFileMode(QFileDialog::Directory);
    dialog.setOption(QFileDialog::ShowDirsOnly);
    if (dialog.exec() == QDialog::Accepted && !dialog.selectedFiles().isEmpty())
        folder_->setText(dialog.selectedFiles().constFirst());
}
