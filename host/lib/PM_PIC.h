#pragma once
// The device personality: what the catalogue says of one part. The speed
// controller is built from it.

#include "lib/Tsy_DeviceCatalog.h"

#include <string>

class PM_PIC {
public:
    // binding is kept for the interface's sake; parts bind to one catalogue.
    PM_PIC(const std::string& partName, int version, int binding);

    bool IsValid() const { return valid_; }
    // Completes what the part name leaves open: a part named without a speed
    // grade takes the family's slowest grade for its speed data.
    void fill_defaults();

    const Tsy_PartInfo& Part() const { return part_; }
    // The grade whose speed data applies (never empty once defaults are filled).
    const std::string& SpeedDataGrade() const { return speedDataGrade_; }

private:
    Tsy_PartInfo part_;
    std::string speedDataGrade_;
    bool valid_ = false;
};
