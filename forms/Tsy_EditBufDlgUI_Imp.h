#pragma once
// The View/Edit Buffer form with the picture of the chosen buffer painted
// in its picture frame.

#include "Tsy_EditBufDlgUI.h"

#include <QImage>
#include <QString>

class Tsy_EditBufDlgUI_Imp : public Tsy_EditBufDlgUI {
    Q_OBJECT
public:
    explicit Tsy_EditBufDlgUI_Imp(QWidget* parent = nullptr);

    // Shows the named picture of the image registry; false (and nothing
    // shown) when the registry has no such picture.
    bool setPicture(const QString& name);
    QString pictureName() const { return pictureName_; }
    // The picture as it is painted, for the picture frame's size.
    const QImage& picture() const { return picture_; }

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    QString pictureName_;
    QImage picture_;
};
