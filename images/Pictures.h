#pragma once
// The pictures the build draws: each has a registry name, a size, a colour
// depth (8 or 24 bits, as the BMP is stored) and a painter function.

#include <QImage>
#include <QString>

#include <functional>
#include <vector>

class QPainter;

struct PictureSpec {
    QString name;
    int width;
    int height;
    int depth;
    std::function<void(QPainter&, const QSize&)> draw;
};

// Each source file of pictures adds its own.
void addTextPictures(std::vector<PictureSpec>& out);
// The buffer symbols of the View/Edit Buffer dialog.
void addBufferPictures(std::vector<PictureSpec>& out);
