#include "gui/Gq_ImageManager.h"

#include <cstring>

Gq_ImageManager* Gq_ImageManager::getInstance()
{
    static Gq_ImageManager instance;
    return &instance;
}

int Gq_ImageManager::addImages(const void* table, int entrySize)
{
    // Entries may carry more than the registry reads, never less.
    if (!table || entrySize < static_cast<int>(sizeof(Gq_ImageEntry)))
        return 0;
    const auto* at = static_cast<const unsigned char*>(table);
    int added = 0;
    for (;; at += entrySize) {
        // The table is a plain byte run from another module: copy each entry
        // out rather than trust its alignment.
        Gq_ImageEntry e;
        std::memcpy(&e, at, sizeof e);
        if (e.size == 0 && !e.data && !e.name)
            break;
        // A nameless entry cannot be asked for, and one claiming bytes it
        // does not have cannot be read; both are passed over.
        if (!e.name || !*e.name || (e.size > 0 && !e.data))
            continue;
        QString name = QString::fromUtf8(e.name);
        if (raw_.contains(name))
            continue;
        // Copied: the table belongs to a plug-in that may be unloaded before
        // the registry is last asked.
        raw_.insert(name, QByteArray(reinterpret_cast<const char*>(e.data), static_cast<qsizetype>(e.size)));
        ++added;
    }
    return added;
}

QImage Gq_ImageManager::getImage(const QString& name) const
{
    auto cached = decoded_.constFind(name);
    if (cached != decoded_.constEnd())
        return cached.value();
    auto raw = raw_.constFind(name);
    if (raw == raw_.constEnd())
        return QImage();
    // The format is guessed from the bytes; bad bytes give a null image, kept
    // too, so a broken picture is not decoded again on every paint.
    QImage image = QImage::fromData(raw.value());
    decoded_.insert(name, image);
    return image;
}
