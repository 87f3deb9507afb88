#pragma once
// Period jitter of the DCM's synthesized output (CLKFX). The figures come
// from empirical fits per family group and synthesizer mode; the fits were
// made in single precision with double constants, and the arithmetic here
// follows them in that precision and order so that the figures a designer
// sees match the ones published with the devices.

class Tsy_DCMwiz;
class Tsy_SpeedData;

class Tsy_JitCalc {
public:
    enum FamilyGroup { GroupTaldor2Pro, GroupGeneration45, GroupOther };

    // The wizard supplies the family and the jitter model; without one the
    // calculator answers for taldor2 in the standard model.
    explicit Tsy_JitCalc(Tsy_DCMwiz* wizard);
    virtual ~Tsy_JitCalc();
    Tsy_JitCalc(const Tsy_JitCalc&) = delete;
    Tsy_JitCalc& operator=(const Tsy_JitCalc&) = delete;

    // fin: the DCM's effective input frequency (MHz); fout: the output
    // frequency (MHz); m, d: the whole multiply and divide values.
    // Standard model: r1 = unit interval, r2 = peak-to-peak ns; r3 and r4
    // are left alone. Noise-free model: r1 = output period (ns), r2 = the
    // standard peak-to-peak figure, r3 = unit interval, r4 = peak-to-peak ns.
    virtual bool CalculateJitter(Tsy_SpeedData* speed, float fin, float fout, int m, int d, float& r1, float& r2,
                                 float& r3, float& r4) const = 0;

    FamilyGroup GetFamilyGroup() const;
    // The noise-free model applies where the family has the BUFGCTRL buffers.
    bool IsNoiseFreeModel() const;

protected:
    // Turns the jitter J (percent of the output period) into the figures of
    // the model in force.
    void ToFigures(float j, float fin, float fout, int d, float& r1, float& r2, float& r3, float& r4) const;

private:
    Tsy_DCMwiz* wizard_;
};
