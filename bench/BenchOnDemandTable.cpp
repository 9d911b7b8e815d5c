// A table of a million lines given on demand, scrolled through: what the desktop's table costs for each
// page of lines it draws (asking the form, splitting the cells, telling numbers from names), the form's
// own text apart. A page must cost far less than a frame for the scroll to follow the mouse.
// Built only with the desktop host, whose folder then gives the header.
#if __has_include("OnDemandTableModel.h")
#include "OnDemandTableModel.h"
#include "ui/Form.h"

#include <benchmark/benchmark.h>
#include <string>

namespace pyr::bench {

namespace {

constexpr int kLines = 1'000'000;
constexpr int kPage = 40; // the lines of a tall table on the screen

class MillionLines : public ui::Form {
public:
    ui::DialogModel& Model() override { return m_model; }
    std::vector<ui::Control> Controls() const override { return {}; }
    bool Open(ui::FrontEnd&) override { return true; }
    ui::ControlState State(int) const override { return {}; }
    void Act(ui::FrontEnd&, int, const ui::Event&) override {}
    int OnDemandRows(int) const override { return kLines; }
    std::string OnDemandRow(int, int rank) const override {
        return "P" + std::to_string(rank) + "\t651050.1180\t6862512.4470\t55.021";
    }

private:
    ui::DialogModel m_model;
};

void BM_OnDemandTablePages(benchmark::State& state) {
    MillionLines form;
    bureau::OnDemandTableModel model(form, 1, {"Point", "X", "Y", "Z"});
    model.Update(1);
    int top = 0;
    for (auto _ : state) {
        // A page shown: every cell's text and alignment, as the view's painting asks for them.
        for (int row = top; row < top + kPage; ++row)
            for (int column = 0; column < 4; ++column) {
                const QModelIndex index = model.index(row, column);
                benchmark::DoNotOptimize(model.data(index));
                benchmark::DoNotOptimize(model.data(index, Qt::TextAlignmentRole));
            }
        // Pages far apart, so that none is kept from the one before.
        top = (top + 997 * kPage) % (kLines - kPage);
    }
    state.SetItemsProcessed(state.iterations() * kPage);
}
BENCHMARK(BM_OnDemandTablePages)->Unit(benchmark::kMicrosecond);

} // namespace

} // namespace pyr::bench

#endif
