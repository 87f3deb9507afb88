#include "lib/Dly_SpeedController.h"

#include "lib/PM_PIC.h"
#include "lib/Tsy_DataDir.h"
#include "lib/Tsy_JsonReader.h"
#include "port/Exception.h"

#include <cfloat>
#include <cmath>

namespace {

void readFigures(const Tsy_JsonReader& r, const std::string& key, std::map<std::string, double>& into)
{
    if (!r.Has(key))
        return;
    const auto& node = r.Node().at(key);
    if (!node.is_object())
        r.FailAt(key, "expected an object of figures");
    for (auto it = node.begin(); it != node.end(); ++it) {
        if (!it.value().is_number() || !std::isfinite(it.value().get<double>()))
            r.FailAt(key + "." + it.key(), "expected a number");
        into[it.key()] = it.value().get<double>();
    }
}

} // namespace

Dly_SpeedController::Dly_SpeedController(const PM_PIC* pic)
{
    if (!pic || !pic->IsValid())
        throw Port::Exception("no part to load speed data for");
    file_ = Tsy_DataFile(pic->Part().family->speedFile);
    nlohmann::ordered_json doc = Tsy_ReadJsonFile(file_);
    Tsy_JsonReader root(doc, file_);
    readFigures(root, "common", bels_);
    readFigures(root, "factors", factors_);
    const std::string& grade = pic->SpeedDataGrade();
    if (!root.Has("grades") || !root.Node().at("grades").contains(grade))
        root.FailAt("grades", "no figures for speed grade '" + grade + "'");
    Tsy_JsonReader grades = root.Child("grades");
    readFigures(grades, grade, bels_);
}

double Dly_SpeedController::GetBelDelay(const std::string& key, const void* /*context*/) const
{
    auto it = bels_.find(key);
    return it == bels_.end() ? DBL_MAX : it->second * 1e-9;
}

double Dly_SpeedController::GetFactor(const std::string& key) const
{
    auto it = factors_.find(key);
    return it == factors_.end() ? DBL_MAX : it->second;
}
