#pragma once
// The message stream: the one sink every message of the wizard goes through.
// Dialogs in GUI mode, "ERROR: ..." / "INFO: ..." lines in batch mode, and a
// recording sink with scripted answers for tests.

#include "port/StringBase.h"

namespace Port {

class Stream {
public:
    virtual ~Stream() = default;

    // Shows (GUI) or logs (batch) a message. isError tells errors from notes;
    // flag3 marks a multi-line report.
    virtual void Message(const StringBase& text, bool isError, bool flag2, bool flag3) = 0;
    // Logs a message without interrupting the user, even in GUI mode.
    virtual void Log(const StringBase& text, bool isError) { Message(text, isError, false, false); }
    // Asks a Yes/No question; non-zero means Yes.
    virtual int Ask(const StringBase& question, const StringBase& second) = 0;

    int ErrorCount() const { return errors_; }

protected:
    void CountError(bool isError)
    {
        if (isError)
            ++errors_;
    }

private:
    int errors_ = 0;
};

} // namespace Port
