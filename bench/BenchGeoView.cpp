// The graphic view of a big job: building what is drawn, redrawing it whole and zoomed in, picking a
// point. A redraw must stay well under 50 ms for panning and zooming to feel immediate.
#include "GeoView.h"
#include "JobGenerator.h"
#include "editor/GeoScene.h"

#include <QApplication>
#include <QImage>
#include <QPainter>
#include <benchmark/benchmark.h>
#include <memory>

namespace pyr::bench {

namespace {

constexpr int kPoints = 100000;
constexpr int kSightings = 200000;
const QSize kImageSize(1600, 1000);

// The widgets need an application; without a display, the offscreen platform draws into images.
QApplication& Application() {
    static int argc = 1;
    static char name[] = "pyr_bench";
    static char* argv[] = {name, nullptr};
    static std::unique_ptr<QApplication> application = [] {
        if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
        return std::make_unique<QApplication>(argc, argv);
    }();
    return *application;
}

const MappedJob& Job() {
    static const MappedJob job = MakeMappedJob(kPoints, kSightings);
    return job;
}

void Counters(benchmark::State& state, const GeoScene& scene) {
    state.counters["points"] = static_cast<double>(scene.Points().size());
    state.counters["visees"] = static_cast<double>(scene.Sightings().size());
}

void BM_GeoSceneBuild(benchmark::State& state) {
    const CCarnet& carnet = Job().carnet;
    GeoScene scene;
    for (auto _ : state) {
        scene.Build(carnet);
        benchmark::DoNotOptimize(scene.Extent());
    }
    Counters(state, scene);
    if (scene.Points().size() != static_cast<std::size_t>(Job().points) ||
        scene.Sightings().size() != static_cast<std::size_t>(Job().sightings))
        state.SkipWithError("la scène ne dessine pas tout le chantier");
}
BENCHMARK(BM_GeoSceneBuild)->Unit(benchmark::kMillisecond);

// A view of the job in a 1600 x 1000 window, showing all of it, or zoomed in `zoom` times about its centre.
void Redraw(benchmark::State& state, double zoom) {
    Application();
    bureau::GeoView view;
    view.resize(kImageSize);
    view.ShowCarnet(Job().carnet);
    view.ZoomAt(QPointF(kImageSize.width() / 2.0, kImageSize.height() / 2.0), zoom);
    QImage image(kImageSize, QImage::Format_ARGB32_Premultiplied);
    for (auto _ : state) {
        QPainter painter(&image);
        view.RenderTo(painter, kImageSize);
    }
    Counters(state, view.Scene());
}

void BM_GeoViewRedrawAll(benchmark::State& state) {
    Redraw(state, 1.0);
}
BENCHMARK(BM_GeoViewRedrawAll)->Unit(benchmark::kMillisecond);

// A window of a fiftieth of the job's extent: the names are written.
void BM_GeoViewRedrawZoomed(benchmark::State& state) {
    Redraw(state, 50.0);
}
BENCHMARK(BM_GeoViewRedrawZoomed)->Unit(benchmark::kMillisecond);

// A click on the whole job shown: 6 pixels are tens of metres, the widest search a pick makes.
void BM_GeoViewPick(benchmark::State& state) {
    const GeoScene scene(Job().carnet);
    const GroundRect& extent = scene.Extent();
    const double tolerance =
        6.0 * std::max(extent.Width() / kImageSize.width(), extent.Height() / kImageSize.height());
    std::uint64_t draw = 1;
    std::int64_t found = 0;
    for (auto _ : state) {
        draw = draw * 6364136223846793005ULL + 1442695040888963407ULL;
        const double u = static_cast<double>(draw >> 40) / static_cast<double>(1 << 24);
        const double v = static_cast<double>((draw >> 16) & 0xFFFFFF) / static_cast<double>(1 << 24);
        const SceneHit hit =
            scene.Pick(extent.minX + u * extent.Width(), extent.minY + v * extent.Height(), tolerance);
        found += static_cast<bool>(hit);
        benchmark::DoNotOptimize(hit.index);
    }
    state.counters["trouves"] =
        benchmark::Counter(static_cast<double>(found) / static_cast<double>(state.iterations()));
}
BENCHMARK(BM_GeoViewPick)->Unit(benchmark::kMicrosecond);

} // namespace

} // namespace pyr::bench
