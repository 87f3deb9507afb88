#pragma once
// A page controller of the wizard window. It owns its page widget only in GUI
// mode; in batch mode no widget is ever built.

#include <QObject>
#include <QPointer>
#include <QString>
#include <QWidget>

class Gq_Wizard;

class Gq_WizardPage : public QObject {
    Q_OBJECT
public:
    explicit Gq_WizardPage(QObject* parent = nullptr);
    ~Gq_WizardPage() override;

    void setPageName(const QString& name) { name_ = name; }
    QString pageName() const { return name_; }
    void setPageBackName(const QString& name) { backName_ = name; }
    QString pageBackName() const { return backName_; }
    void setPageNextName(const QString& name) { nextName_ = name; }
    QString pageNextName() const { return nextName_; }

    // Takes ownership of the widget.
    void setPageWidget(QWidget* widget);
    QWidget* pageWidget() const { return widget_; }

    // A hidden page is passed over by Back and Next.
    void hidePage(bool hide) { hidden_ = hide; }
    bool isHidden() const { return hidden_; }

    Gq_Wizard* wizard() const { return wizard_; }
    void setWizard(Gq_Wizard* wizard) { wizard_ = wizard; }

    // Called each time the page becomes the current page; by default it
    // fills the widgets from the data.
    virtual void onActive() { dataToWidgets(); }
    virtual void dataToWidgets() {}
    virtual void widgetsToData() {}
    // Next and Back move on only when these return true.
    virtual bool onNext() { return true; }
    virtual bool onBack() { return true; }
    // Finish closes the window only when this returns true.
    virtual bool onFinish() { return true; }
    virtual void onCancel() {}
    virtual void onAdvanced() {}
    virtual void onMoreInfo() {}

private:
    QString name_;
    QString backName_;
    QString nextName_;
    QPointer<QWidget> widget_;
    Gq_Wizard* wizard_ = nullptr;
    bool hidden_ = false;
};
