#pragma once
// The buffer records an output pin carries: a list of buffers numbered from 1
// without gaps ("TSY_CLKBUFTYPE%d" and its "_NOEDIT" state, and the
// "TSY_CLKBUF%d_..." names of the buffer's ports). The Clock Buffers page and
// the View/Edit Buffer dialog write them; design generation reads them.

#include "port/StringBase.h"

class Tsy_Pin;

namespace Tsy_BufferRecords {

// Row states, as recorded in "TSY_CLKBUFTYPE%d_NOEDIT".
enum RowState { StateDisabled = 0, StateEnabled = 1, StateFeedback = 2, StateDefault = 3 };

// The name a buffer type is shown under; a type we do not know shows as stored.
StringBase ShownName(const StringBase& type);
// The picture of the type in the image registry; empty when it has none.
StringBase PictureName(const StringBase& type);
// Two inputs, I0 and I1: BUFGMUX, BUFGMUX_TALDOR4, BUFGMUX_CTRL, BUFGCTRL.
bool IsMuxType(const StringBase& type);
// Types that take a dedicated global clock buffer: BUFG, BUFGCE and the muxes.
bool IsGlobalType(const StringBase& type);

// The type of buffer n; empty when the pin or the record is missing.
StringBase TypeOf(const Tsy_Pin* pin, int n);
// The state recorded for buffer n; no pin or no record reads as enabled.
int ReadRowState(int n, const Tsy_Pin* pin);
// Records the type of buffer n and its state (enabled removes the state record).
void WriteBufferType(Tsy_Pin* pin, int n, const StringBase& type, int state);
void WriteRowState(Tsy_Pin* pin, int n, int state);

// The smallest n whose "TSY_CLKBUFTYPE%d" is empty.
int NextFreeBuffer(const Tsy_Pin* pin);
// Whether the pin carries any attribute named "TSY_CLKBUFTYPE...".
bool HasAnyBufferRecord(const Tsy_Pin* pin);
// Whether the pin holds a buffer with a type under a number other than n.
bool HasOtherBuffer(const Tsy_Pin* pin, int n);

// The buffer number a record name belongs to ("TSY_CLKBUFTYPE3_NOEDIT" and
// "TSY_CLKBUF3_O_SIGNAME" give 3), 0 for any other name. head and tail get
// the text around the number.
int BufferNumberOf(const StringBase& attrName, StringBase* head = nullptr, StringBase* tail = nullptr);
// Removes every record of buffer n, keeping the other buffers' numbers.
void ClearBuffer(Tsy_Pin* pin, int n);
// Removes buffer n and moves each later buffer k down to k - 1, so that the
// list stays without gaps.
void RemoveBuffer(Tsy_Pin* pin, int n);

} // namespace Tsy_BufferRecords
