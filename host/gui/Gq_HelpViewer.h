#pragma once
// The help viewer: shows the bundled HTML page of a help topic key
// (data/help/<key>.html) in a browser window.

#include <QString>

class QWidget;

class Gq_HelpViewer {
public:
    // Opens the topic; false when the key has no page.
    static bool showTopic(const QString& topicKey, QWidget* parent);
    // The file of the topic, empty when there is none.
    static QString topicFile(const QString& topicKey);
    // The window of the last topic shown (tests), or null.
    static QWidget* currentWindow();
};
