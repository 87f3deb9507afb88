#include "support/TestDesign.h"

#include "port/Exception.h"
#include "run/Tsy_HostSession.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <sys/wait.h>

TestDesign::TestDesign(const std::string& keyword, const std::string& part, bool batch)
{
    if (!Tsy_DeviceCatalog::Instance().FindPart(part, part_))
        throw Port::Exception("test asks for unknown part " + part);
    data_ = Tsy_NewDesignFor(part_);
    wizard_ = std::make_unique<Tsy_DCMwiz>(keyword, batch);
    Tsy_WizContext ctx = Tsy_ContextForPart(part_);
    ctx.moduleName = "clkgen";
    ctx.data = data_.get();
    ctx.stream = &stream_;
    wizard_->SetContext(ctx);
}

TestDesign::~TestDesign()
{
    wizard_.reset();
}

void TestDesign::Configure(const std::function<void(Tsy_WizContext&)>& change)
{
    Tsy_WizContext ctx = wizard_->Context();
    change(ctx);
    wizard_->SetContext(ctx);
}

void TestDesign::MarkLoaded()
{
    Configure([](Tsy_WizContext& c) {
        c.loadedDesign = true;
        c.defaultSetup = false;
    });
}

void TestDesign::Instantiate()
{
    wizard_->InstantiatePages();
}

std::vector<std::string> Texts(const std::vector<StringBase>& messages)
{
    std::vector<std::string> out;
    for (const auto& m : messages)
        out.push_back(m.str());
    return out;
}

bool Contains(const std::vector<std::string>& texts, const std::string& text)
{
    return std::find(texts.begin(), texts.end(), text) != texts.end();
}

std::string ReadTextFile(const std::string& path)
{
    std::ifstream in(path, std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

TempDir::TempDir()
{
    char pattern[] = "/tmp/pendra-test-XXXXXX";
    const char* made = ::mkdtemp(pattern);
    if (!made)
        throw Port::Exception("cannot make a scratch folder");
    path_ = made;
}

TempDir::~TempDir()
{
    std::string command = "rm -rf '" + path_ + "'";
    if (std::system(command.c_str()) != 0)
        std::fprintf(stderr, "could not remove %s\n", path_.c_str());
}

CommandResult RunCommand(const std::string& command)
{
    TempDir scratch;
    std::string full = command + " >" + scratch.File("out") + " 2>" + scratch.File("err");
    int raw = std::system(full.c_str());
    CommandResult r;
    r.status = WIFEXITED(raw) ? WEXITSTATUS(raw) : -1;
    r.out = ReadTextFile(scratch.File("out"));
    r.err = ReadTextFile(scratch.File("err"));
    return r;
}
