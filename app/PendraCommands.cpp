#include "PendraCommands.h"

#include "gui/Gq_StartDialog.h"
#include "gui/Tsy_DialogStream.h"
#include "lib/Tsy_DataDir.h"
#include "lib/Tsy_DeviceCatalog.h"
#include "port/Exception.h"
#include "port/StringBase.h"
#include "run/Tsy_PluginLoader.h"
#include "run/Tsy_WizardCatalog.h"
#include "wiz/Tsy_MessageStreams.h"
#include "wiz/Tsy_WizMain.h"

#include <QApplication>

#include <cstdio>
#include <iostream>

namespace {

int usageError(const std::string& message)
{
    std::cerr << "pendra: " << message << std::endl;
    return Tsy_HostSession::kUsage;
}

bool matches(const std::string& text, const std::string& filter)
{
    return StringBase(text).Upper().GetIndexOfString(StringBase(filter).Upper()) >= 0;
}

} // namespace

int PendraListWizards()
{
    try {
        auto catalog = Tsy_WizardCatalog::LoadFile(Tsy_DataFile("wizards.json"));
        // Without the plug-in every type is listed as not available.
        std::string error;
        const Tsy_PluginLoader* loader = Tsy_PluginLoader::Shared(catalog->PluginFile(), error);
        for (const auto& w : catalog->Wizards()) {
            bool available = loader && loader->Create(w.key, true) != nullptr;
            std::printf("%-15s %s%s\n", w.key.c_str(), w.description.c_str(),
                        available ? "" : " (not available in this build)");
        }
    } catch (const Port::Exception& e) {
        return usageError(e.what());
    }
    return Tsy_HostSession::kOk;
}

int PendraListParts(const std::string& filter)
{
    try {
        for (const auto& p : Tsy_DeviceCatalog::Instance().Parts()) {
            const std::string& family = p.family->key;
            if (!filter.empty() && !matches(p.part, filter) && !matches(family, filter) && !matches(p.device, filter)
                && !matches(p.speedGrade, filter))
                continue;
            std::printf("%-16s %-10s %-12s %s\n", p.part.c_str(), family.c_str(), p.device.c_str(),
                        p.speedGrade.c_str());
        }
    } catch (const Port::Exception& e) {
        return usageError(e.what());
    }
    return Tsy_HostSession::kOk;
}

int PendraGenerate(const Tsy_RunOptions& options)
{
    Tsy_BatchStream stream;
    Tsy_HostSession session(stream);
    std::string error;
    if (session.Prepare(options, error) != Tsy_HostSession::kOk)
        return usageError(error);
    int rc = session.Run();
    if (rc == Tsy_HostSession::kUsage)
        return usageError(session.Error());
    if (rc != Tsy_HostSession::kOk)
        return rc;
    for (const auto& f : session.WrittenFiles())
        std::printf("%s\n", f.c_str());
    return Tsy_HostSession::kOk;
}

int PendraGui(Tsy_RunOptions options, int argc, char** argv)
{
    QApplication app(argc, argv);
    QApplication::setOrganizationName("Corvane");
    QApplication::setApplicationName("Pendra");
    options.batch = false;
    if (options.designFile.empty() && (options.wizard.empty() || options.part.empty())) {
        QString why;
        std::unique_ptr<Gq_StartDialog> start = Gq_StartDialog::fromDataDir(why);
        if (!start)
            return usageError(why.toStdString());
        if (!options.wizard.empty())
            start->setWizardKey(QString::fromStdString(options.wizard));
        if (!options.part.empty())
            start->setPart(QString::fromStdString(options.part));
        if (!options.module.empty())
            start->setModuleName(QString::fromStdString(options.module));
        start->setOutputFolder(QString::fromStdString(options.outDir));
        if (start->exec() != QDialog::Accepted)
            return Tsy_HostSession::kFailed;
        options.wizard = start->wizardKey().toStdString();
        options.part = start->part().toStdString();
        options.module = start->moduleName().toStdString();
        options.outDir = start->outputFolder().toStdString();
    }
    Tsy_DialogStream stream;
    Tsy_HostSession session(stream);
    std::string error;
    if (session.Prepare(options, error) != Tsy_HostSession::kOk)
        return usageError(error);
    int rc = session.Run();
    for (const auto& f : session.WrittenFiles())
        std::printf("%s\n", f.c_str());
    return rc;
}
