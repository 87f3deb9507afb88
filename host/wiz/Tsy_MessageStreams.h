#pragma once

#include "wiz/Port_Stream.h"

#include <deque>
#include <iosfwd>
#include <vector>

// Batch mode: one "ERROR: ..." or "INFO: ..." line per message on the given
// stream (standard error by default). Questions are logged and answered Yes,
// since a batch run has nobody to ask; pages do not ask in batch mode.
class Tsy_BatchStream : public Port::Stream {
public:
    Tsy_BatchStream();
    explicit Tsy_BatchStream(std::ostream& out);
    void Message(const StringBase& text, bool isError, bool flag2, bool flag3) override;
    int Ask(const StringBase& question, const StringBase& second) override;

private:
    std::ostream& out_;
};

// Tests: every message and question is recorded; questions take the scripted
// answers in order, then the default answer.
class Tsy_RecordingStream : public Port::Stream {
public:
    struct Entry {
        StringBase text;
        bool isError = false;
        bool flag2 = false;
        bool flag3 = false;
        bool question = false;
        bool logged = false;
    };

    void Message(const StringBase& text, bool isError, bool flag2, bool flag3) override;
    void Log(const StringBase& text, bool isError) override;
    int Ask(const StringBase& question, const StringBase& second) override;

    void ScriptAnswers(std::initializer_list<int> answers) { answers_.insert(answers_.end(), answers); }
    void SetDefaultAnswer(int answer) { defaultAnswer_ = answer; }

    const std::vector<Entry>& Entries() const { return entries_; }
    std::vector<StringBase> Texts() const;
    std::vector<StringBase> Errors() const;
    std::vector<StringBase> Notes() const;
    std::vector<StringBase> Questions() const;
    void Clear() { entries_.clear(); }

private:
    std::vector<Entry> entries_;
    std::deque<int> answers_;
    int defaultAnswer_ = 1;
};
