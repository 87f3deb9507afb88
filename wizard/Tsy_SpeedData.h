#pragma once
// The target part's speed-file figures, loaded once per wizard: frequency
// limits by key (in MHz), factors by key, with the performance-mode key
// translation and the missing-key message.

#include "port/StringBase.h"

class Dly_SpeedController;
class PM_PIC;
class Tsy_DCMwiz;

class Tsy_SpeedData {
public:
    enum PerformanceMode { MaxSpeed = 0, MaxRange = 1 };

    Tsy_SpeedData();
    ~Tsy_SpeedData();
    Tsy_SpeedData(const Tsy_SpeedData&) = delete;
    Tsy_SpeedData& operator=(const Tsy_SpeedData&) = delete;

    void SetWizard(Tsy_DCMwiz* wizard) { wizard_ = wizard; }
    // Builds the personality and takes the shared controller for it.
    bool Load(const StringBase& partName);

    // The figure of the key in MHz; 0 when it is missing (after the
    // missing-key message) or without speed data.
    float GetSpeedValue(const StringBase& key);
    // The factor of the key; positive infinity when it is missing.
    float GetFactor(const StringBase& key);
    // The key as the speed file spells it for the current performance mode.
    StringBase TranslateKey(const StringBase& key);

    int GetPerformanceMode() const { return perfMode_; }
    void SetPerformanceMode(int mode) { perfMode_ = mode; }
    bool IsQuiet() const { return quiet_; }
    void SetQuiet(bool quiet) { quiet_ = quiet; }
    bool IsMembra3e() const { return membra3e_; }
    bool HasController() const { return controller_ != nullptr; }

    static float FreqToPeriod(float mhz);
    static float PeriodToFreq(float ns);
    static float Multiply10000(float v);
    static float Divide10000(float v);
    // Reduces a / b to lowest terms; non-positive inputs are left as they are.
    static bool ReduceRatio(int a, int b, int& aOut, int& bOut);
    // 0 when M is outside 2..32, 1 when D is outside 1..32, else 2.
    static int CheckMultiplyDivide(float m, float d);

private:
    void releaseController();

    Dly_SpeedController* controller_ = nullptr;
    Tsy_DCMwiz* wizard_ = nullptr;
    PM_PIC* pic_ = nullptr;
    int perfMode_ = MaxSpeed;
    bool quiet_ = false;
    bool membra3e_ = false;
};
