#pragma once
// The controller of the Clock Buffers page. It holds the sixteen buffer rows
// of the grid, derives them from the buffer records of the source block's
// output pins, writes the default buffers, runs the View/Edit Buffer dialog
// on a row and checks the rows on Next. Without a form (batch runs) it works
// the same way and only draws nothing.

#include "gui/Gq_WizardPage.h"
#include "pages/dcm/Tsy_BufferEdit.h"
#include "port/StringBase.h"

#include <QPointer>

#include <functional>
#include <iosfwd>
#include <vector>

class QWidget;
class Tsy_Block;
class Tsy_ClockBufDlg;
class Tsy_ClockBufDlgUI;
class Tsy_DCMwiz;
class Tsy_EditBufDlgGui;
class Tsy_Pin;
class Tsy_Signal;
class Tsy_WizData;

class Tsy_ClockBufDlgGui : public Gq_WizardPage {
    Q_OBJECT
public:
    static constexpr int kRows = 16;
    enum Mode { ModeGlobal = 0, ModeCustomize = 1 };

    struct Row {
        StringBase i0;
        StringBase i1;
        StringBase type;
        int bufIndex = 0; // the n of "TSY_CLKBUFTYPE%d" on the I0 pin
        int state = 1;
        int pmcdInst = 1;
        bool edited = false;
    };

    // A source output as the page lists it.
    struct Output {
        StringBase shown; // "CLK0", or "U2 CLKA1" in parallel PMCD designs
        StringBase pin;
        int pmcdInst = 1;
    };

    // parent may be null; without a form (batch) no widget is made.
    Tsy_ClockBufDlgGui(Tsy_ClockBufDlg* page, QWidget* parent, int instNum);
    ~Tsy_ClockBufDlgGui() override;

    // Once after creation: the name prefix, the radio buttons, the signals.
    void SetUp();
    void SetNamePrefix();
    void SetBatch(bool batch) { batch_ = batch; }

    void onActive() override;
    bool onNext() override;
    bool onBack() override;
    void onMoreInfo() override;

    void LoadFromBlock();
    void RefreshRows(bool reload);
    void AssignDefaultBuffers();
    bool StoreToBlock(bool validate);
    bool CheckFeedbackBuffer();
    bool CheckGlobalBufferCount();
    void LoadFeedbackSettings(Tsy_Block* block);
    void ConvertLegacyBuffers(bool reload);
    // The type of buffer n of an output after its repairs, and its state.
    StringBase NormalizeBufferType(Tsy_Pin* pin, int n, const StringBase& output, int& state);
    void SetRow(int r, const StringBase& type, int n, const StringBase& i0, const StringBase& i1, int state);

    // Opens row r (1..16) in the View/Edit Buffer dialog.
    void EditRow(int r);
    void AddBuffer();

    int GetMode() const { return mode_; }
    const Row& GetRow(int r) const;
    int GetLastUsedRow() const { return lastUsedRow_; }
    const std::vector<Output>& GetOutputs() const { return outputs_; }
    const StringBase& GetPmcdMode() const { return pmcdMode_; }
    const StringBase& GetNamePrefix() const { return prefix_; }
    const StringBase& GetFeedbackOutput() const { return fbOutput_; }
    bool IsLeftByBack() const { return leftByBack_; }
    Tsy_BufferEdit& Editor() { return editor_; }
    Tsy_ClockBufDlgUI* Form() const { return form_; }
    Tsy_EditBufDlgGui* EditDialog() const;
    Tsy_ClockBufDlg* LogicalPage() const { return page_; }
    // How a row is put before the user: by default the dialog. Returns 1 for OK.
    void SetEditRunner(std::function<int(Tsy_BufferEdit&)> runner) { editRunner_ = std::move(runner); }
    // The row table, for diagnostics.
    void DumpRows(std::ostream& out) const;

public slots:
    void OnRadioUseBufgs();
    void OnRadioUseGrid();
    void OnButtonAddBuf();
    void OnButtonEdit1() { EditRow(1); }
    void OnButtonEdit2() { EditRow(2); }
    void OnButtonEdit3() { EditRow(3); }
    void OnButtonEdit4() { EditRow(4); }
    void OnButtonEdit5() { EditRow(5); }
    void OnButtonEdit6() { EditRow(6); }
    void OnButtonEdit7() { EditRow(7); }
    void OnButtonEdit8() { EditRow(8); }
    void OnButtonEdit9() { EditRow(9); }
    void OnButtonEdit10() { EditRow(10); }
    void OnButtonEdit11() { EditRow(11); }
    void OnButtonEdit12() { EditRow(12); }
    void OnButtonEdit13() { EditRow(13); }
    void OnButtonEdit14() { EditRow(14); }
    void OnButtonEdit15() { EditRow(15); }
    void OnButtonEdit16() { EditRow(16); }

private:
    bool isSingleBlockType() const;
    bool isPllDesign() const;
    bool isPmcdDesign() const;
    Tsy_Block* dcmBlock();
    Tsy_Block* pllBlock();
    // The block whose pins carry the records of the output.
    Tsy_Block* blockOf(const Output& output);
    Tsy_Pin* pinOf(const Output& output);
    void readPmcdMode();
    void buildOutputList();
    void defaultPass(bool dcmRules);
    bool takesNoDefaultRow(const Output& o) const;
    bool closesFeedbackLoop(const Output& o, bool internal) const;
    // Fills row r with a buffer of output o; returns the next row.
    int takeRow(int r, const StringBase& type, int n, const StringBase& i0, const StringBase& i1, int state,
                const Output& o);
    // The default pass fills the rows from row 1 (globalBufferRows,
    // recordedBufferRows) or from row r; each returns the first row it left
    // free. internal: the DCM's feedback loop is closed inside the design.
    int globalBufferRows(bool internal);
    int recordedBufferRows(bool internal);
    int recordedRowsOf(const Output& o, Tsy_Pin* pin, bool internal, int r);
    int defaultRowOf(const Output& o, Tsy_Pin* pin, bool internal, int r);
    StringBase shownFirstInput(const Output& o, const Tsy_Pin* pin, const StringBase& type, int state) const;
    // Legacy designs: buffer blocks and marked nets become buffer records.
    bool isLegacyConversionDue(bool reload) const;
    void convertLegacyOutput(const Output& o);
    void recordRouting(Tsy_Pin* pin, const Tsy_Signal* sig, const StringBase& net, const char* type);
    bool isLegacyBufferOn(const Tsy_Block& b, const StringBase& net) const;
    void recordLegacyBuffer(const Output& o, Tsy_Pin* pin, Tsy_Block& b);
    void recordLegacyMuxI1(const Output& o, Tsy_Pin* pin, int n, const Tsy_Block& mux);
    void dropExtraBuffers(Tsy_Pin* pin);
    void reportOverflow(const StringBase& output);
    bool internalFeedback() const;
    int runEditor();
    void applyEdit(int r, bool isNew);

    // The form, when there is one.
    void readModeFromRadios();
    void syncRadios();
    void updateAddButton();
    void drawRow(int r);
    void connectForm();

    QWidget* parent_;
    Tsy_ClockBufDlg* page_;
    Tsy_WizData* data_;
    Tsy_DCMwiz* wiz_;
    QPointer<Tsy_EditBufDlgGui> editDlg_;
    Tsy_ClockBufDlgUI* form_ = nullptr;
    int wizType_;
    int mode_ = ModeGlobal;
    int instNum_;
    Row rows_[kRows + 1]; // rows 1..16; 0 unused
    int lastUsedRow_ = 0;
    bool clkoutDcm_ = false;
    bool leftByBack_ = false;
    bool messagesEnabled_ = true;
    bool batch_;
    StringBase fbOutput_;
    StringBase fbSource_;
    StringBase clkFeedback_;
    StringBase prefix_;
    std::vector<Output> outputs_;
    StringBase pmcdMode_ = "NONE";
    Tsy_BufferEdit editor_;
    std::function<int(Tsy_BufferEdit&)> editRunner_;
    bool guard_ = false;
};
