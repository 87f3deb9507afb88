#pragma once
// The first question of a GUI run without a design file: which wizard, for
// which part, under which module name, written to which folder.

#include "gui/Gq_Dialog.h"
#include "run/Tsy_WizardCatalog.h"

#include <memory>
#include <vector>

class QComboBox;
class QDialogButtonBox;
class QFormLayout;
class QLabel;
class QLineEdit;
class QPushButton;
class Tsy_DeviceCatalog;

class Gq_StartDialog : public Gq_Dialog {
    Q_OBJECT
public:
    // The wizard list is copied; the device catalogue must outlive the dialog.
    Gq_StartDialog(const Tsy_WizardCatalog& wizards, const Tsy_DeviceCatalog& devices, QWidget* parent = nullptr);
    ~Gq_StartDialog() override;

    // The dialog over the installed catalogues (wizards.json and the device
    // catalogue of the data directory); null, with the reason, when either
    // cannot be read.
    static std::unique_ptr<Gq_StartDialog> fromDataDir(QString& error, QWidget* parent = nullptr);

    QString wizardKey() const;
    // The part as the catalogue spells it when it knows it, else as typed.
    QString part() const;
    QString moduleName() const;
    QString outputFolder() const;

    // Preset choices (the options the program was started with). An unknown
    // wizard key leaves the choice as it was.
    void setWizardKey(const QString& key);
    void setPart(const QString& part);
    void setModuleName(const QString& name);
    void setOutputFolder(const QString& folder);

    // Why OK is disabled; empty when every field is acceptable.
    QString problem() const;
    QPushButton* okButton() const { return ok_; }

private:
    void makeWizardChoice();
    void makePartChoice();
    void makeModuleField();
    void makeFolderField();
    void makeNotes();
    QFormLayout* fieldForm();
    QDialogButtonBox* makeButtonBox();
    void layOutDialog();
    void connectFields();

    void revalidate();
    void browse();
    QString partProblem() const;

    std::vector<Tsy_WizardInfo> wizards_;
    const Tsy_DeviceCatalog& devices_;
    QComboBox* wizard_ = nullptr;
    QComboBox* part_ = nullptr;
    QLineEdit* module_ = nullptr;
    QLineEdit* folder_ = nullptr;
    QPushButton* browse_ = nullptr;
    QPushButton* ok_ = nullptr;
    QLabel* partNote_ = nullptr;
    QLabel* moduleNote_ = nullptr;
    QLabel* folderNote_ = nullptr;
};
