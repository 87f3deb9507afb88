#pragma once
// The busy note shown while something slow loads. Does nothing without a
// running GUI application.

#include "port/StringBase.h"

#include <memory>

class QWidget;

class Tsy_Wait2Dlg {
public:
    Tsy_Wait2Dlg();
    ~Tsy_Wait2Dlg();
    void SetText(const StringBase& text);
    // Shows the note and lets it paint.
    void Run();
    void Quit();
    bool IsShown() const;

private:
    StringBase text_;
    std::unique_ptr<QWidget> window_;
};
