#include "lib/PM_PIC.h"

#include "port/Exception.h"

PM_PIC::PM_PIC(const std::string& partName, int /*version*/, int /*binding*/)
{
    try {
        valid_ = Tsy_DeviceCatalog::Instance().FindPart(partName, part_);
    } catch (const Port::Exception&) {
        valid_ = false;
    }
    if (valid_)
        speedDataGrade_ = part_.speedGrade;
}

void PM_PIC::fill_defaults()
{
    if (valid_ && speedDataGrade_.empty())
        speedDataGrade_ = Tsy_DeviceCatalog::Instance().SpeedGradesOf(*part_.deviceInfo).front();
}
