#pragma once
// The General Setup form with its DCM symbol painted between the pin boxes:
// the primitive, the instance and every pin in use, each output drawn level
// with its box.

#include "Tsy_DCMgenSetupUI.h"

#include <QStringList>

class Tsy_DCMgenSetupUI_Imp : public Tsy_DCMgenSetupUI {
    Q_OBJECT
public:
    struct Symbol {
        QString primitive = QStringLiteral("DCM");
        QString instance;    // "INST1", "INST2" or empty
        QStringList inputs;  // pin captions in use, left side
        QStringList outputs; // pin names in use, right side
    };

    explicit Tsy_DCMgenSetupUI_Imp(QWidget* parent = nullptr);
    ~Tsy_DCMgenSetupUI_Imp() override;

    void setSymbol(const Symbol& symbol);
    const Symbol& symbol() const { return symbol_; }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    // The vertical centre of a pin row in the frame's coordinates.
    int rowCentre(int row) const;
    int rowPitch() const;
    void paintSymbol(QPainter& painter) const;

    Symbol symbol_;
};
