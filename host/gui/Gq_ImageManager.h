#pragma once
// The named image registry. Images arrive as one table of entries (byte size,
// data, name) ending with an all-zero entry, and are decoded on first use.

#include <QHash>
#include <QImage>
#include <QString>

struct Gq_ImageEntry {
    unsigned int size;
    const unsigned char* data;
    const char* name;
};

class Gq_ImageManager {
public:
    static Gq_ImageManager* getInstance();

    // Registers every entry of the table; entrySize is the size of one entry.
    // A name given twice keeps its first image. Returns the number added.
    int addImages(const void* table, int entrySize);
    // The image of that name; a null image when there is none or its data
    // cannot be decoded.
    QImage getImage(const QString& name) const;
    bool hasImage(const QString& name) const { return raw_.contains(name); }
    int imageCount() const { return raw_.size(); }

private:
    Gq_ImageManager() = default;
    QHash<QString, QByteArray> raw_;
    mutable QHash<QString, QImage> decoded_;
};
