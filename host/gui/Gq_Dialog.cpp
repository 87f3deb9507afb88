#include "gui/Gq_Dialog.h"

#include <QByteArray>
#include <QSettings>
#include <QShowEvent>

namespace {

const char* const kOrganisation = "Corvane";
const char* const kApplication = "Pendra";

QString geometryKey(const QString& dialog)
{
    return "Dialogs/" + dialog + "/geometry";
}

} // namespace

Gq_Dialog::Gq_Dialog(QWidget* parent, Qt::WindowFlags flags) : QDialog(parent, flags) {}

Gq_Dialog::~Gq_Dialog() = default;

QString Gq_Dialog::settingsKey() const
{
    QString name = objectName();
    if (name.isEmpty())
        name = QString::fromLatin1(metaObject()->className());
    // Slashes would open sub-groups of the settings file.
    return name.replace('/', '_');
}

void Gq_Dialog::showEvent(QShowEvent* event)
{
    // Only the first time: a dialog hidden and shown again keeps where the
    // user left it in this session.
    if (!restored_ && !event->spontaneous()) {
        restored_ = true;
        QSettings settings(kOrganisation, kApplication);
        QByteArray saved = settings.value(geometryKey(settingsKey())).toByteArray();
        if (!saved.isEmpty())
            restoreGeometry(saved);
    }
    QDialog::showEvent(event);
}

void Gq_Dialog::done(int result)
{
    // Saved whichever way the dialog closes; a dialog never shown has no
    // placement of the user's to keep.
    if (restored_) {
        QSettings settings(kOrganisation, kApplication);
        settings.setValue(geometryKey(settingsKey()), saveGeometry());
    }
    QDialog::done(result);
}
