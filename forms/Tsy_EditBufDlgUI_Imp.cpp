#include "Tsy_EditBufDlgUI_Imp.h"

#include "gui/Gq_ImageManager.h"

#include <QPainter>

Tsy_EditBufDlgUI_Imp::Tsy_EditBufDlgUI_Imp(QWidget* parent) : Tsy_EditBufDlgUI(parent) {}

bool Tsy_EditBufDlgUI_Imp::setPicture(const QString& name)
{
    QImage image = name.isEmpty() ? QImage() : Gq_ImageManager::getInstance()->getImage(name);
    pictureName_ = image.isNull() ? QString() : name;
    picture_ = image;
    update();
    return !image.isNull();
}

void Tsy_EditBufDlgUI_Imp::paintEvent(QPaintEvent* event)
{
    Tsy_EditBufDlgUI::paintEvent(event);
    if (picture_.isNull())
        return;
    // The frame is transparent: the picture shows through it, centred.
    QRect frame = FrameBufferPicture->geometry();
    QRect target(QPoint(0, 0), picture_.size().scaled(frame.size(), Qt::KeepAspectRatio));
    target.moveCenter(frame.center());
    QPainter p(this);
    if (!isEnabled())
        p.setOpacity(0.5);
    p.drawImage(target, picture_);
}
