#pragma once
// The delay calculator's view of a part's speed file: figures by key name.
// Bel figures are reported in the calculator's base unit, 1e-9 of the figure
// written in the speed file (so a frequency written in MHz reads as MHz once
// multiplied by 1e9); factors are reported as written. A missing key reads
// as the largest finite double.

#include <map>
#include <memory>
#include <string>

class PM_PIC;

class Dly_SpeedController {
public:
    // Loads the speed file of the personality's family and grade; throws
    // Port::Exception naming the file and the fault when it cannot.
    explicit Dly_SpeedController(const PM_PIC* pic);

    double GetBelDelay(const std::string& key, const void* context) const;
    double GetFactor(const std::string& key) const;
    const std::string& SpeedFile() const { return file_; }

private:
    std::string file_;
    std::map<std::string, double> bels_;
    std::map<std::string, double> factors_;
};
