#pragma once
// The family classes that select the rules of the pages, by family key.

#include "port/StringBase.h"

namespace Tsy_Family {

// taldor4, qtaldor4, qrtaldor4, taldor5: DCM_ADV, performance modes, PMCD.
bool IsGeneration45(const StringBase& family);
// taldor4, qtaldor4, qrtaldor4 (not taldor5).
bool IsGeneration4(const StringBase& family);
// membra3e, membra3a, membra3an, amembra3e.
bool IsMembra3E(const StringBase& family);
// taldor2p, qtaldor2p.
bool IsTaldor2Pro(const StringBase& family);
// taldor2, qtaldor2, qrtaldor2.
bool IsTaldor2(const StringBase& family);
// membra3, amembra3.
bool IsMembra3(const StringBase& family);
bool Is(const StringBase& family, const char* key);

} // namespace Tsy_Family
