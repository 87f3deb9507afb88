#pragma once
// GUI mode messages: errors and notes in message boxes, questions as Yes/No
// boxes; logged messages go to standard error.

#include "wiz/Port_Stream.h"

class QWidget;

class Tsy_DialogStream : public Port::Stream {
public:
    explicit Tsy_DialogStream(QWidget* parent = nullptr) : parent_(parent) {}
    void setParent(QWidget* parent) { parent_ = parent; }

    void Message(const StringBase& text, bool isError, bool flag2, bool flag3) override;
    void Log(const StringBase& text, bool isError) override;
    int Ask(const StringBase& question, const StringBase& second) override;

private:
    // The given parent, else the dialog or window the user is working in.
    QWidget* owner() const;
    QWidget* parent_;
};
