#pragma once
// The wizard window: a stack of pages with More Info, Advanced, Back, Next,
// Finish and Cancel. Back and Next carry the names of the neighbouring pages.

#include <QDialog>
#include <QList>

#include <functional>

class Gq_WizardPage;
class QHBoxLayout;
class QLabel;
class QPushButton;
class QStackedWidget;

class Gq_Wizard : public QDialog {
    Q_OBJECT
public:
    enum Button { MoreInfo, Advanced, Back, Next, Finish, Cancel };

    explicit Gq_Wizard(QWidget* parent = nullptr);
    ~Gq_Wizard() override;

    void setCaption(const QString& caption);
    void showMoreInfo(bool show);
    void showAdvanced(bool show);
    void enableMoreInfo(bool enable);
    void enableAdvanced(bool enable);
    // Appends the page and its widget; the window takes no ownership of the
    // controller, only of the widget once shown.
    void addPage(Gq_WizardPage* page);

    int pageCount() const { return pages_.size(); }
    Gq_WizardPage* page(int index) const;
    Gq_WizardPage* currentPage() const;
    int currentIndex() const { return current_; }
    QPushButton* button(Button which) const;

    // Shows the first page that is not hidden.
    void start();
    // The actions of the buttons; each returns whether it moved on.
    bool goNext();
    bool goBack();
    bool finish();

    // Run when Finish is pressed after the current page agreed; true closes
    // the window with Accepted.
    void setFinishHandler(std::function<bool()> handler) { finishHandler_ = std::move(handler); }

protected:
    void reject() override;

private:
    void makeTitle();
    void makePageStack();
    void makeButtons();
    void connectButtons();
    QHBoxLayout* buttonRow() const;
    void layOutWindow();

    void showPage(int index);
    bool enter(int index, int step);
    bool moveTo(int index, int step);
    int neighbour(int from, int step) const;
    QString buttonName(int to, int step) const;
    void updateButtons();
    void forgetPage(QObject* gone);

    QList<Gq_WizardPage*> pages_;
    int current_ = -1;
    QStackedWidget* stack_ = nullptr;
    QWidget* blank_ = nullptr;
    QLabel* title_ = nullptr;
    QPushButton* buttons_[6] = {};
    std::function<bool()> finishHandler_;
};
