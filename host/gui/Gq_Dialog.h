#pragma once
// A dialog whose placement is remembered between runs (QSettings, keyed by
// the dialog's object name or class).

#include <QDialog>

class Gq_Dialog : public QDialog {
    Q_OBJECT
public:
    explicit Gq_Dialog(QWidget* parent = nullptr, Qt::WindowFlags flags = Qt::WindowFlags());
    ~Gq_Dialog() override;

protected:
    void showEvent(QShowEvent* event) override;
    void done(int result) override;

private:
    QString settingsKey() const;
    bool restored_ = false;
};
