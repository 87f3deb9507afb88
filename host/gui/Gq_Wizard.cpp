#include "gui/Gq_Wizard.h"

#include "gui/Gq_WizardPage.h"

#include <QFrame>
#include <QHBoxLayout>
#include <QKeySequence>
#include <QLabel>
#include <QPushButton>
#include <QStackedWidget>
#include <QVBoxLayout>

namespace {

// A page name shown on a button must not turn its own letters into
// mnemonics; the button's accelerator is set separately.
QString literal(const QString& text)
{
    QString out = text;
    return out.replace('&', "&&");
}

QFrame* sunkenLine(QWidget* parent)
{
    auto* line = new QFrame(parent);
    line->setFrameShape(QFrame::HLine);
    line->setFrameShadow(QFrame::Sunken);
    return line;
}

struct ButtonLook {
    const char* name;
    const char* text;
    QKeySequence key;
    const char* tip;
};

QPushButton* makeButton(QWidget* parent, const ButtonLook& look)
{
    auto* b = new QPushButton(parent);
    b->setObjectName(look.name);
    b->setText(look.text);
    b->setShortcut(look.key);
    b->setToolTip(look.tip);
    b->setAutoDefault(false);
    return b;
}

} // namespace

Gq_Wizard::Gq_Wizard(QWidget* parent) : QDialog(parent)
{
    setObjectName("Gq_Wizard");
    setSizeGripEnabled(true);
    makeTitle();
    makePageStack();
    makeButtons();
    connectButtons();
    layOutWindow();
    // Room for the largest page form plus the title and the button row.
    setMinimumSize(740, 620);
    // Tab walks the page first, then the buttons left to right.
    for (int i = 0; i + 1 < 6; ++i)
        setTabOrder(buttons_[i], buttons_[i + 1]);
    updateButtons();
}

void Gq_Wizard::makeTitle()
{
    title_ = new QLabel(this);
    title_->setObjectName("WizardPageTitle");
    QFont titleFont = title_->font();
    titleFont.setBold(true);
    titleFont.setPointSizeF(titleFont.pointSizeF() * 1.25);
    title_->setFont(titleFont);
    title_->setTextFormat(Qt::PlainText);
}

void Gq_Wizard::makePageStack()
{
    stack_ = new QStackedWidget(this);
    stack_->setObjectName("WizardPageStack");
    // Shown while no page is current, so the stack never shows a stale page.
    blank_ = new QWidget(stack_);
    stack_->addWidget(blank_);
}

void Gq_Wizard::makeButtons()
{
    // The page forms carry their own Alt-letter accelerators (Alt+N, Alt+F
    // and Alt+M among them), so the buttons every page shares keep to keys
    // no form uses: Enter for Next (Finish on the last page), Esc for Cancel.
    const ButtonLook looks[6] = {
        {"ButtonMoreInfo", "More Info", QKeySequence(Qt::Key_F1), "Open the help page of this page (F1)"},
        {"ButtonAdvanced", "&Advanced...", QKeySequence(Qt::ALT | Qt::Key_A),
         "Open the advanced settings of this page (Alt+A)"},
        {"ButtonBack", "< Back", QKeySequence(Qt::ALT | Qt::Key_Left), "Go back to the previous page (Alt+Left)"},
        {"ButtonNext", "Next >", QKeySequence(Qt::ALT | Qt::Key_Right), "Check this page and go on (Enter, Alt+Right)"},
        {"ButtonFinish", "Finish", QKeySequence(), "Generate the design and write its files (Enter on the last page)"},
        // Esc is the dialog's own: it rejects at once, like the button.
        {"ButtonCancel", "Cancel", QKeySequence(), "Close the wizard without writing anything (Esc)"},
    };
    for (int i = 0; i < 6; ++i)
        buttons_[i] = makeButton(this, looks[i]);
    buttons_[Next]->setDefault(true);
}

void Gq_Wizard::connectButtons()
{
    connect(buttons_[MoreInfo], &QPushButton::clicked, this, [this] {
        if (Gq_WizardPage* p = currentPage())
            p->onMoreInfo();
    });
    connect(buttons_[Advanced], &QPushButton::clicked, this, [this] {
        if (Gq_WizardPage* p = currentPage())
            p->onAdvanced();
    });
    connect(buttons_[Back], &QPushButton::clicked, this, [this] { goBack(); });
    connect(buttons_[Next], &QPushButton::clicked, this, [this] { goNext(); });
    connect(buttons_[Finish], &QPushButton::clicked, this, [this] { finish(); });
    connect(buttons_[Cancel], &QPushButton::clicked, this, &Gq_Wizard::reject);
}

QHBoxLayout* Gq_Wizard::buttonRow() const
{
    auto* row = new QHBoxLayout;
    row->addWidget(buttons_[MoreInfo]);
    row->addWidget(buttons_[Advanced]);
    row->addStretch(1);
    row->addWidget(buttons_[Back]);
    row->addWidget(buttons_[Next]);
    row->addSpacing(12);
    row->addWidget(buttons_[Finish]);
    row->addWidget(buttons_[Cancel]);
    return row;
}

void Gq_Wizard::layOutWindow()
{
    QHBoxLayout* row = buttonRow();
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(title_);
    layout->addWidget(sunkenLine(this));
    layout->addWidget(stack_, 1);
    layout->addWidget(sunkenLine(this));
    layout->addLayout(row);
}

Gq_Wizard::~Gq_Wizard()
{
    // Controllers usually outlive the window; leave none of them pointing at
    // it, and let no destruction signal reach this half-destroyed object.
    for (Gq_WizardPage* p : pages_) {
        disconnect(p, nullptr, this, nullptr);
        if (p->wizard() == this)
            p->setWizard(nullptr);
    }
    pages_.clear();
}

void Gq_Wizard::setCaption(const QString& caption)
{
    setWindowTitle(caption);
}

void Gq_Wizard::showMoreInfo(bool show)
{
    buttons_[MoreInfo]->setVisible(show);
}

void Gq_Wizard::showAdvanced(bool show)
{
    buttons_[Advanced]->setVisible(show);
}

void Gq_Wizard::enableMoreInfo(bool enable)
{
    buttons_[MoreInfo]->setEnabled(enable);
}

void Gq_Wizard::enableAdvanced(bool enable)
{
    buttons_[Advanced]->setEnabled(enable);
}

void Gq_Wizard::addPage(Gq_WizardPage* page)
{
    if (!page || pages_.contains(page))
        return;
    pages_.append(page);
    page->setWizard(this);
    if (QWidget* w = page->pageWidget())
        stack_->addWidget(w);
    // A controller deleted while the window lives leaves the sequence.
    connect(page, &QObject::destroyed, this, [this](QObject* gone) { forgetPage(gone); });
    updateButtons();
}

void Gq_Wizard::forgetPage(QObject* gone)
{
    int index = -1;
    for (int i = 0; i < pages_.size(); ++i)
        if (static_cast<QObject*>(pages_[i]) == gone)
            index = i;
    if (index < 0)
        return;
    pages_.removeAt(index);
    if (current_ == index) {
        current_ = -1;
        stack_->setCurrentWidget(blank_);
        title_->clear();
    } else if (current_ > index) {
        --current_;
    }
    updateButtons();
}

Gq_WizardPage* Gq_Wizard::page(int index) const
{
    return index >= 0 && index < pages_.size() ? pages_[index] : nullptr;
}

Gq_WizardPage* Gq_Wizard::currentPage() const
{
    return page(current_);
}

QPushButton* Gq_Wizard::button(Button which) const
{
    return which >= MoreInfo && which <= Cancel ? buttons_[which] : nullptr;
}

int Gq_Wizard::neighbour(int from, int step) const
{
    for (int i = from + step; i >= 0 && i < pages_.size(); i += step)
        if (!pages_[i]->isHidden())
            return i;
    return -1;
}

void Gq_Wizard::start()
{
    int first = neighbour(-1, +1);
    if (first < 0 || !enter(first, +1)) {
        current_ = -1;
        stack_->setCurrentWidget(blank_);
        title_->clear();
        updateButtons();
    }
}

bool Gq_Wizard::goNext()
{
    Gq_WizardPage* p = currentPage();
    if (!p || neighbour(current_, +1) < 0)
        return false;
    if (!p->onNext())
        return false;
    // The page may have hidden or revealed pages while storing.
    int to = neighbour(current_, +1);
    if (to < 0) {
        updateButtons();
        return false;
    }
    return moveTo(to, +1);
}

bool Gq_Wizard::goBack()
{
    Gq_WizardPage* p = currentPage();
    if (!p || neighbour(current_, -1) < 0)
        return false;
    if (!p->onBack())
        return false;
    int to = neighbour(current_, -1);
    if (to < 0) {
        updateButtons();
        return false;
    }
    return moveTo(to, -1);
}

bool Gq_Wizard::moveTo(int index, int step)
{
    int from = current_;
    if (enter(index, step))
        return true;
    // Every page that way hid itself on entry: stay where the user was.
    if (from >= 0)
        showPage(from);
    return false;
}

// A page may find on entry that it has nothing to show (it hides itself);
// the wizard then passes through it in the direction of travel.
bool Gq_Wizard::enter(int index, int step)
{
    for (int i = index; i >= 0; i = neighbour(i, step)) {
        showPage(i);
        if (!pages_[i]->isHidden())
            return true;
    }
    return false;
}

void Gq_Wizard::showPage(int index)
{
    Gq_WizardPage* p = page(index);
    if (!p)
        return;
    current_ = index;
    QWidget* w = p->pageWidget();
    if (w && stack_->indexOf(w) < 0)
        stack_->addWidget(w);
    stack_->setCurrentWidget(w ? w : blank_);
    title_->setText(p->pageName());
    p->onActive();
    updateButtons();
}

bool Gq_Wizard::finish()
{
    Gq_WizardPage* p = currentPage();
    if (!p || neighbour(current_, +1) >= 0)
        return false;
    if (!p->onFinish())
        return false;
    if (finishHandler_ && !finishHandler_())
        return false;
    accept();
    return true;
}

void Gq_Wizard::reject()
{
    if (Gq_WizardPage* p = currentPage())
        p->onCancel();
    QDialog::reject();
}

QString Gq_Wizard::buttonName(int to, int step) const
{
    const Gq_WizardPage* here = currentPage();
    const Gq_WizardPage* there = page(to);
    QString given = step < 0 ? here->pageBackName() : here->pageNextName();
    // The names given to a page describe its adjacent pages; when hidden
    // pages lie between, the button names the page it really leads to.
    bool adjacent = to == current_ + step;
    if ((given.isEmpty() || !adjacent) && there && !there->pageName().isEmpty())
        return there->pageName();
    return given;
}

void Gq_Wizard::updateButtons()
{
    int back = current_ >= 0 ? neighbour(current_, -1) : -1;
    int next = current_ >= 0 ? neighbour(current_, +1) : -1;
    bool last = current_ >= 0 && next < 0;

    QPushButton* b = buttons_[Back];
    QString name = back >= 0 ? buttonName(back, -1) : QString();
    b->setText(name.isEmpty() ? QString("< Back") : "< " + literal(name));
    b->setShortcut(QKeySequence(Qt::ALT | Qt::Key_Left));
    b->setToolTip(name.isEmpty() ? QString("Go back to the previous page (Alt+Left)")
                                 : QString("Go back to %1 (Alt+Left)").arg(name));
    b->setEnabled(back >= 0);

    QPushButton* n = buttons_[Next];
    name = next >= 0 ? buttonName(next, +1) : (currentPage() ? currentPage()->pageNextName() : QString());
    n->setText(name.isEmpty() ? QString("Next >") : literal(name) + " >");
    n->setShortcut(QKeySequence(Qt::ALT | Qt::Key_Right));
    n->setToolTip(name.isEmpty() ? QString("Check this page and go on (Enter, Alt+Right)")
                                 : QString("Check this page and go on to %1 (Enter, Alt+Right)").arg(name));
    n->setEnabled(next >= 0);

    buttons_[Finish]->setEnabled(last);
    // Enter moves on; on the last page it finishes.
    n->setDefault(!last);
    buttons_[Finish]->setDefault(last);
}
