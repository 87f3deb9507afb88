#include "wiz/Tsy_MessageStreams.h"

#include <iostream>

namespace {

// Messages are written as the pages compose them; trailing line breaks of
// multi-line reports add nothing on a console.
std::string withoutTrailingBreaks(const StringBase& text)
{
    std::string s = text.str();
    while (!s.empty() && (s.back() == '\n' || s.back() == ' '))
        s.pop_back();
    return s;
}

} // namespace

Tsy_BatchStream::Tsy_BatchStream() : out_(std::cerr) {}

Tsy_BatchStream::Tsy_BatchStream(std::ostream& out) : out_(out) {}

void Tsy_BatchStream::Message(const StringBase& text, bool isError, bool, bool)
{
    CountError(isError);
    out_ << (isError ? "ERROR: " : "INFO: ") << withoutTrailingBreaks(text) << std::endl;
}

int Tsy_BatchStream::Ask(const StringBase& question, const StringBase&)
{
    out_ << "INFO: " << withoutTrailingBreaks(question) << std::endl;
    return 1;
}

void Tsy_RecordingStream::Message(const StringBase& text, bool isError, bool flag2, bool flag3)
{
    CountError(isError);
    entries_.push_back(Entry{text, isError, flag2, flag3, false, false});
}

void Tsy_RecordingStream::Log(const StringBase& text, bool isError)
{
    CountError(isError);
    entries_.push_back(Entry{text, isError, false, false, false, true});
}

int Tsy_RecordingStream::Ask(const StringBase& question, const StringBase&)
{
    entries_.push_back(Entry{question, false, false, false, true, false});
    if (answers_.empty())
        return defaultAnswer_;
    int answer = answers_.front();
    answers_.pop_front();
    return answer;
}

std::vector<StringBase> Tsy_RecordingStream::Texts() const
{
    std::vector<StringBase> out;
    for (const auto& e : entries_)
        out.push_back(e.text);
    return out;
}

std::vector<StringBase> Tsy_RecordingStream::Errors() const
{
    std::vector<StringBase> out;
    for (const auto& e : entries_)
        if (e.isError && !e.question)
            out.push_back(e.text);
    return out;
}

std::vector<StringBase> Tsy_RecordingStream::Notes() const
{
    std::vector<StringBase> out;
    for (const auto& e : entries_)
        if (!e.isError && !e.question)
            out.push_back(e.text);
    return out;
}

std::vector<StringBase> Tsy_RecordingStream::Questions() const
{
    std::vector<StringBase> out;
    for (const auto& e : entries_)
        if (e.question)
            out.push_back(e.text);
    return out;
}
