#include "calc/Levelling.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Carnet.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"
#include "settings/CalcOptions.h"

#include <algorithm>
#include <cmath>
#include <optional>

namespace pyr {

namespace {

constexpr const char* kKeyToleranceMode = "TypeTolerance";
constexpr const char* kKeyDistribution = "TypeNivel";
constexpr const char* kKeyClosure = "FermAltimetr";
constexpr const char* kKeyHeightTolerance = "TolAltitudes";

// Comparisons with a tolerance forgive the last bits of a sum of readings: a misclosure of exactly the
// tolerance, typed as such, is within it.
constexpr double kComparisonSlack = 1e-9;

// Staff readings and height differences are shown to the tenth of a millimetre.
constexpr int kDecimals = 4;

// The elements that belong to another kind of work and end the levelling written before them.
bool EndsLevelling(int kind) {
    return kind == kKindStation || IsSightingKind(kind) || kind == kKindChemin;
}

// The steps of a block, cut into chains where a step does not start where the previous one ended.
std::vector<std::vector<LevellingStep>> Chains(const std::vector<LevellingSetUp>& block,
                                               LevellingMethod method) {
    std::vector<LevellingStep> steps;
    for (std::size_t i = 0; i < block.size(); ++i) {
        LevellingStep step;
        step.from = block[i].backPoint;
        step.to = block[i].forwardPoint;
        step.setUps.push_back(block[i]);
        const bool paired = method == LevellingMethod::DoubleStation && i + 1 < block.size() &&
                            block[i + 1].backPoint == step.from && block[i + 1].forwardPoint == step.to;
        if (paired) {
            const LevellingSetUp& second = block[++i];
            step.setUps.push_back(second);
            const double first = step.setUps[0].HeightDifference();
            step.heightDifference = (first + second.HeightDifference()) / 2.0;
            step.pairGap = first - second.HeightDifference();
            const double a = step.setUps[0].Length();
            const double b = second.Length();
            step.length = IsKnown(a) && IsKnown(b) ? (a + b) / 2.0 : kUndefined;
        } else {
            step.heightDifference = block[i].HeightDifference();
            step.length = block[i].Length();
        }
        steps.push_back(std::move(step));
    }

    std::vector<std::vector<LevellingStep>> chains;
    for (LevellingStep& step : steps) {
        if (chains.empty() || chains.back().back().to != step.from) chains.emplace_back();
        chains.back().push_back(std::move(step));
    }
    return chains;
}

} // namespace

LevellingOptions LevellingOptions::FromOptions(std::string_view paramPath, LevellingMethod method) {
    LevellingOptions options;
    options.method = method;
    options.closureMode = static_cast<LevellingToleranceMode>(
        std::clamp(ReadOptionInt(paramPath, kSectionLevelling, kKeyToleranceMode), 0, 2));
    options.closureTolerance = ReadOptionReal(paramPath, kSectionLevelling, kKeyClosure);
    options.distribution = static_cast<LevellingDistribution>(
        std::clamp(ReadOptionInt(paramPath, kSectionLevelling, kKeyDistribution), 0, 2));
    options.pairTolerance = ReadOptionReal(paramPath, kSectionTolerances, kKeyHeightTolerance);
    return options;
}

double LevellingOptions::ClosureTolerance(double lengthMetres, int stepCount) const {
    switch (closureMode) {
    case LevellingToleranceMode::PerKm:
        return IsKnown(lengthMetres) ? closureTolerance * std::sqrt(lengthMetres / 1000.0) : closureTolerance;
    case LevellingToleranceMode::PerSetUp:
        return closureTolerance * std::sqrt(static_cast<double>(std::max(stepCount, 1)));
    case LevellingToleranceMode::Fixed:
        break;
    }
    return closureTolerance;
}

double LevellingSetUp::Length() const {
    return IsKnown(backDistance) && IsKnown(forwardDistance) ? backDistance + forwardDistance : kUndefined;
}

LevellingSetUps ReadLevellingSetUps(const CCarnet& carnet) {
    LevellingSetUps result;
    std::vector<LevellingSetUp> block;
    std::optional<LevellingSetUp> current;
    std::vector<LevellingSideReading> forwards; // the forward readings of the current set-up so far

    const auto closeSetUp = [&] {
        if (!current) return;
        if (forwards.empty()) {
            result.problems.push_back(Sprintf(kLevellingNoForwardReading, current->backPoint.c_str()));
        } else {
            const LevellingSideReading& last = forwards.back();
            current->forwardPoint = last.point;
            current->forwardElement = last.element;
            current->forwardReading = last.reading;
            current->forwardDistance = last.distance;
            forwards.pop_back();
            current->sides = std::move(forwards);
            block.push_back(std::move(*current));
        }
        current.reset();
        forwards.clear();
    };
    const auto closeBlock = [&] {
        closeSetUp();
        if (!block.empty()) result.blocks.push_back(std::move(block));
        block.clear();
    };

    for (int i = 0; i < carnet.GetSize(); ++i) {
        const int kind = carnet.GetType(i);
        if (IsLevellingKind(kind)) {
            const CLecture* reading = carnet.As<CLecture>(i);
            if (!reading) continue;
            if (kind == kKindLectAR) {
                closeSetUp();
                LevellingSetUp setUp;
                setUp.backPoint = reading->mat();
                setUp.backElement = i;
                setUp.backReading = reading->lm();
                setUp.backDistance = reading->dist();
                current = std::move(setUp);
            } else if (!current) {
                result.problems.push_back(Sprintf(kLevellingNoBackReading, reading->mat().c_str()));
            } else {
                LevellingSideReading side;
                side.point = reading->mat();
                side.element = i;
                side.reading = reading->lm();
                side.distance = reading->dist();
                carnet.hasZ(side.point, side.knownZ);
                forwards.push_back(std::move(side));
            }
        } else if (EndsLevelling(kind)) {
            closeBlock();
        }
    }
    closeBlock();
    return result;
}

void CompensateLevellingRun(LevellingRun& run, const LevellingOptions& options) {
    const int count = static_cast<int>(run.steps.size());
    run.closedLoop = run.start == run.end;
    run.warnings.clear();

    double length = 0.0;
    double sum = 0.0;
    bool lengthsKnown = true;
    for (const LevellingStep& step : run.steps) {
        sum += step.heightDifference;
        if (IsKnown(step.length))
            length += step.length;
        else
            lengthsKnown = false;
    }
    run.length = lengthsKnown ? length : kUndefined;
    double climb = 0.0;
    for (const LevellingStep& step : run.steps)
        climb += std::fabs(step.heightDifference);
    // The weight of a step under the rule that applies to this run.
    run.distribution = LevellingDistribution::BySetUp;
    if (options.distribution == LevellingDistribution::ByDistance && lengthsKnown && length > 0.0)
        run.distribution = LevellingDistribution::ByDistance;
    if (options.distribution == LevellingDistribution::ByHeightDifference && climb > 0.0)
        run.distribution = LevellingDistribution::ByHeightDifference;
    const auto weight = [&run](const LevellingStep& step) {
        switch (run.distribution) {
        case LevellingDistribution::ByDistance:
            return step.length;
        case LevellingDistribution::ByHeightDifference:
            return std::fabs(step.heightDifference);
        case LevellingDistribution::BySetUp:
            break;
        }
        return 1.0;
    };
    run.misclosure = run.zStart + sum - run.zEnd;
    run.tolerance = options.ClosureTolerance(run.length, count);
    run.inTolerance = std::fabs(run.misclosure) <= run.tolerance + kComparisonSlack;

    // Each point takes -f times the share of the run (of its length, or of its steps) behind it; the
    // last one is the arrival benchmark itself.
    const double whole = run.distribution == LevellingDistribution::ByDistance           ? length
                         : run.distribution == LevellingDistribution::ByHeightDifference ? climb
                                                                                         : count;
    double behind = 0.0;
    double measured = 0.0;
    double previousCorrection = 0.0;
    double z = run.zStart;
    for (int i = 0; i < count; ++i) {
        LevellingStep& step = run.steps[i];
        behind += weight(step);
        measured += step.heightDifference;
        const double correction = i + 1 == count ? -run.misclosure : -run.misclosure * behind / whole;
        step.correction = correction - previousCorrection;
        previousCorrection = correction;
        step.zFrom = z;
        step.zTo = i + 1 == count ? run.zEnd : run.zStart + measured + correction;
        z = step.zTo;

        for (LevellingSetUp& setUp : step.setUps) {
            const double instrumentLine = step.zFrom + setUp.backReading;
            for (LevellingSideReading& side : setUp.sides)
                side.z = instrumentLine - side.reading;
        }

        if (options.method != LevellingMethod::DoubleStation) continue;
        if (step.setUps.size() < 2) {
            run.warnings.push_back(Sprintf(kLevellingSingleReading, step.from.c_str(), step.to.c_str()));
            continue;
        }
        step.pairOutOfTolerance = std::fabs(step.pairGap) > options.pairTolerance + kComparisonSlack;
        if (step.pairOutOfTolerance)
            run.warnings.push_back(Sprintf(kLevellingPairOutOfTolerance, step.from.c_str(), step.to.c_str(),
                                           FormatFixed(step.setUps[0].HeightDifference(), kDecimals).c_str(),
                                           FormatFixed(step.setUps[1].HeightDifference(), kDecimals).c_str(),
                                           FormatFixed(std::fabs(step.pairGap), kDecimals).c_str(),
                                           FormatFixed(options.pairTolerance, kDecimals).c_str()));
    }
    run.flagged = !run.warnings.empty();
}

namespace {

// The benchmarks of a chain (ranks of its points) without those that stand between `start` and the next
// `end` after it: a run named by its two ends passes through them.
template <typename PointAt>
void PassThroughBetween(std::vector<std::size_t>& benchmarks, std::vector<double>& heights,
                        const PointAt& point, const std::string& start, const std::string& end) {
    std::vector<std::size_t> kept;
    std::vector<double> keptHeights;
    for (std::size_t j = 0; j < benchmarks.size(); ++j) {
        kept.push_back(benchmarks[j]);
        keptHeights.push_back(heights[j]);
        if (point(benchmarks[j]) != start) continue;
        std::size_t k = j + 1;
        while (k < benchmarks.size() && point(benchmarks[k]) != end)
            ++k;
        if (k < benchmarks.size()) j = k - 1; // the next one kept is that end
    }
    benchmarks = std::move(kept);
    heights = std::move(keptHeights);
}

} // namespace

LevellingResult ComputeLevelling(const CCarnet& carnet, const LevellingSetUps& setUps,
                                 const LevellingOptions& options) {
    LevellingResult result;
    result.problems = setUps.problems;
    for (const std::vector<LevellingSetUp>& block : setUps.blocks) {
        for (const std::vector<LevellingStep>& chain : Chains(block, options.method)) {
            // The points of the chain: the start of every step, then the end of the last one.
            const auto point = [&](std::size_t k) -> const std::string& {
                return k < chain.size() ? chain[k].from : chain.back().to;
            };
            std::vector<std::size_t> benchmarks;
            std::vector<double> heights;
            for (std::size_t k = 0; k <= chain.size(); ++k) {
                double z = kUndefined;
                if (carnet.hasZ(point(k), z)) {
                    benchmarks.push_back(k);
                    heights.push_back(z);
                }
            }
            if (benchmarks.empty()) {
                result.problems.push_back(
                    Sprintf(kLevellingNoBenchmark, point(0).c_str(), point(chain.size()).c_str()));
                continue;
            }
            if (!options.start.empty() && !options.end.empty())
                PassThroughBetween(benchmarks, heights, point, options.start, options.end);
            if (benchmarks.front() > 0)
                result.problems.push_back(Sprintf(kLevellingNoBenchmarkAtStart, point(0).c_str(),
                                                  point(benchmarks.front()).c_str()));
            for (std::size_t j = 0; j + 1 < benchmarks.size(); ++j) {
                LevellingRun run;
                run.start = point(benchmarks[j]);
                run.end = point(benchmarks[j + 1]);
                run.zStart = heights[j];
                run.zEnd = heights[j + 1];
                run.steps.assign(chain.begin() + static_cast<std::ptrdiff_t>(benchmarks[j]),
                                 chain.begin() + static_cast<std::ptrdiff_t>(benchmarks[j + 1]));
                CompensateLevellingRun(run, options);
                result.runs.push_back(std::move(run));
            }
            if (benchmarks.back() < chain.size())
                result.problems.push_back(
                    Sprintf(kLevellingNoBenchmarkAtEnd, point(benchmarks.back()).c_str()));
        }
    }
    return result;
}

LevellingResult ComputeLevelling(const CCarnet& carnet, const LevellingOptions& options) {
    return ComputeLevelling(carnet, ReadLevellingSetUps(carnet), options);
}

} // namespace pyr
