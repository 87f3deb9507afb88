#pragma once
// Driving widgets as a user does under the offscreen platform: windows shown
// and activated, controls found by their object names, modal windows
// answered, and pictures kept for a person to look at.

#include "gui/Gq_Wizard.h"
#include "gui/Gq_WizardPage.h"

#include <QComboBox>
#include <QLineEdit>
#include <QRadioButton>

#include <gtest/gtest.h>

#include <functional>
#include <ostream>

class Tsy_WizPage;

// Failures show texts as text.
inline void PrintTo(const QString& text, std::ostream* out)
{
    *out << '"' << text.toStdString() << '"';
}

// Accelerators reach only the active window.
bool ShowAndActivate(QWidget* window);
// Runs the event loop until the condition holds, for at most a few seconds:
// an accelerator clicks its button a moment after the key.
bool Eventually(const std::function<bool()>& condition);
// Runs open(), which blocks in a modal window's event loop, and hands the
// first modal window to appear to answer; gives back what open returned.
int WhileModal(const std::function<int()>& open, const std::function<void(QWidget*)>& answer);

// The child of that object name, as a test tool finds it; a failure when
// there is none.
template <typename T>
T* Named(const QObject* root, const QString& name)
{
    T* w = root ? root->findChild<T*>(name) : nullptr;
    EXPECT_NE(w, nullptr) << name.toStdString();
    return w;
}

// Replaces what a line edit or an editable combo box holds, key by key.
void Retype(QWidget* field, const QString& text);
// Clicks a radio button on its indicator, where a click always lands.
void Pick(QRadioButton* radio);
// Chooses an entry of a combo box with the arrow keys.
bool Choose(QComboBox* combo, const QString& text);
QStringList Items(const QComboBox* combo);
// With PENDRA_SCREENSHOT_DIR set, keeps a picture of the widget there.
void Snap(QWidget* widget, const QString& name);

// A wizard window holding one page's form, shown, active and started, with a
// page after it so that Next has somewhere to go.
class PageWindow {
public:
    explicit PageWindow(Tsy_WizPage* page);
    ~PageWindow();

    Gq_WizardPage* gui = nullptr;
    Gq_WizardPage after;
    Gq_Wizard window;
    bool active = false;
};
