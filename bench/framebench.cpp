// The frame in the window: the step slider against drawing its lines once, and the cold start.
#include "benchapp.h"
#include "framepane.h"
#include "ratios.h"

#include <QApplication>
#include <QMouseEvent>
#include <QPainter>
#include <QPixmap>
#include <benchmark/benchmark.h>

#include <cmath>
#include <cstdlib>
#include <memory>
#include <string>

namespace {

/// A frame of so many bays and storeys.
struct T_SIZE {
    int bays, deep, storeys;
    int NodeAt(int x, int y, int z) const { return 1 + x + (bays + 1) * (y + (deep + 1) * z); }
};
constexpr T_SIZE kSlider{25, 25, 11}; // 20,436 elements
constexpr T_SIZE kOrbit{41, 40, 10};  // 50,830 elements
constexpr int kSteps = 20;

/// A space frame of columns and beams with a pushover along X.
T_MODEL_CONTENT Content(const T_SIZE& size)
{
    T_MODEL_CONTENT content;
    T_MODEL& model = content.model;
    T_PUSH_DATA result;
    int id = 0;
    const auto add = [&](int i, int j) {
        T_ELEM_D e;
        e.id = ++id;
        e.nodeI = i;
        e.nodeJ = j;
        model.elements[id] = e;
    };
    for (int z = 0; z <= size.storeys; ++z)
        for (int y = 0; y <= size.deep; ++y)
            for (int x = 0; x <= size.bays; ++x) {
                T_NODE_D node;
                node.id = size.NodeAt(x, y, z);
                node.xyz = {6.0 * x, 6.0 * y, 3.0 * z};
                if (z == 0) node.restraint = {1, 1, 1, 1, 1, 1};
                model.nodes[node.id] = node;
                if (z > 0) add(size.NodeAt(x, y, z - 1), node.id);
                if (z > 0 && x > 0) add(size.NodeAt(x - 1, y, z), node.id);
                if (z > 0 && y > 0) add(size.NodeAt(x, y - 1, z), node.id);
                for (int s = 1; s <= kSteps; ++s)
                    result.displacement[node.id].push_back(0.001 * s * z);
            }
    result.loadFactor.assign(kSteps, 1.0);
    result.baseReaction.assign(kSteps, 1.0);
    model.pushovers[1].name = "X";
    model.pushovers[1].controlNode = size.NodeAt(0, 0, size.storeys);
    content.results[1] = MakePushResult(std::move(result));
    return content;
}

/// The pane with a large frame.
struct T_BENCH {
    CDBDoc doc;
    CFrameScene scene{doc};
    CSelection selection;
    std::unique_ptr<CFramePane> pane;
    explicit T_BENCH(const T_SIZE& size)
    {
        NeedBenchApp();
        doc.Data().Assign(Content(size));
        pane = std::make_unique<CFramePane>(doc, scene, selection);
        pane->resize(1000, 760);
        pane->show();
        QApplication::processEvents();
        (void)pane->Show(pane->Sources().back(), kSteps);
    }
};

void FrameStep(benchmark::State& state)
{
    T_BENCH bench(kSlider);
    CFramePane& pane = *bench.pane;
    int step = 1;
    for (auto _ : state) {
        pane.SetStep(step);
        pane.View().repaint();
        step = step % kSteps + 1;
    }
    if (bench.scene.Scene().lines.size() < 20000) state.SkipWithError("not enough elements");
}

/// The mouse turns the frame by a pixel, and it is drawn: without displacements, and displaced over
/// the frame as it was. Items a second are frames.
void Orbit(benchmark::State& state, bool displaced, bool perspective)
{
    T_BENCH bench(kOrbit);
    CFrameView& view = bench.pane->View();
    if (!displaced) (void)bench.pane->Show(bench.pane->Sources().front(), 1);
    T_CAMERA camera = view.Camera();
    camera.perspective = perspective;
    view.SetCamera(camera);
    view.repaint();
    const auto mouse = [&](QEvent::Type type, double x) {
        const QPointF at(x, 300.0);
        QMouseEvent event(type, at, view.mapToGlobal(at), Qt::LeftButton, Qt::LeftButton, {});
        QCoreApplication::sendEvent(&view, &event);
    };
    double x = 100.0;
    mouse(QEvent::MouseButtonPress, x);
    const double yaw = view.Camera().yawDeg;
    for (auto _ : state) {
        mouse(QEvent::MouseMove, x += 1.0);
        view.repaint();
    }
    state.SetItemsProcessed(state.iterations());
    if (bench.scene.Scene().lines.size() < 50000) state.SkipWithError("not enough elements");
    if (view.Camera().yawDeg == yaw) state.SkipWithError("it does not turn");
}

/// The same lines on a picture of the same size, places given.
void FrameLinesOnce(benchmark::State& state)
{
    T_BENCH bench(kSlider);
    const T_FRAME_SCENE& scene = bench.scene.Scene();
    std::vector<QLineF> lines;
    const double rad = std::acos(-1.0) / 4.0, px = 3.2;
    const auto place = [&](const T_SCENE_NODE& node) {
        const double x = std::cos(rad) * (node.xyz[0] + node.xyz[1]);
        const double y = 0.577 * std::sin(rad) * (node.xyz[1] - node.xyz[0]) + 0.816 * node.xyz[2];
        return QPointF(20.0 + px * x, 380.0 - px * y);
    };
    for (const T_SCENE_LINE& line : scene.lines)
        lines.emplace_back(place(scene.nodes[line.i]), place(scene.nodes[line.j]));
    QPixmap picture(bench.pane->View().size());
    for (auto _ : state) {
        picture.fill(Qt::white);
        QPainter painter(&picture);
        painter.setPen(QPen(Qt::blue, 0));
        painter.drawLines(lines.data(), static_cast<int>(lines.size()));
    }
}

void Start(benchmark::State& state, const char* option)
{
    const std::string command = std::string("QT_QPA_PLATFORM=offscreen HOME=/nonexistent ") +
                                QM_DESKTOP_PROGRAM + " " + option + " > /dev/null 2>&1";
    for (auto _ : state) {
        if (std::system(command.c_str()) != 0) state.SkipWithError("the program failed");
    }
}
void DesktopStart(benchmark::State& state)
{
    Start(state, "--start-only");
}
void EmptyWindowStart(benchmark::State& state)
{
    const std::string command =
        std::string("QT_QPA_PLATFORM=offscreen ") + QM_EMPTY_WINDOW + " > /dev/null 2>&1";
    for (auto _ : state) {
        if (std::system(command.c_str()) != 0) state.SkipWithError("the program failed");
    }
}

BENCHMARK(FrameStep)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(Orbit, Still, false, false)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(Orbit, Displaced, true, false)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(Orbit, Perspective, true, true)->Unit(benchmark::kMillisecond);
BENCHMARK(FrameLinesOnce)->Unit(benchmark::kMillisecond);
BENCHMARK(DesktopStart)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(EmptyWindowStart)->Unit(benchmark::kMillisecond)->UseRealTime();

[[maybe_unused]] const int kRatios[] = {
    AddRatio({"step slider, 20,436 elements / drawing their lines once", "FrameStep",
              "FrameLinesOnce", 1.0, 1.5}),
    AddRatio(
        {"desktop start / start of an empty window", "DesktopStart", "EmptyWindowStart", 1.0, 3.0}),
};

} // namespace
