#pragma once

// The GéoBase of a level run read by a perfect level, written as the level's field book is: benchmarks,
// back readings, forward readings, every sight of the same length.
#include "geobase/Carnet.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <memory>

namespace pyr::test {

namespace level_job {
// True heights (metres): A and B the benchmarks, T1 and T2 turning points, S a side point levelled from
// the set-up on T1.
inline constexpr double kA = 100.000, kT1 = 101.234, kT2 = 99.876, kB = 100.543, kS = 100.111;
} // namespace level_job

struct LevelJob {
    CCarnet carnet;
    double sight = 30.0; // metres, so that a misclosure is shared in equal parts by set-up

    void Benchmark(const char* name, double z) {
        carnet.Add(std::make_unique<CPointGen>(name, z), kKindPoint);
    }
    void Back(const char* point, double reading) {
        carnet.Add(std::make_unique<CLectAR>(point, reading, sight), kKindLectAR);
    }
    void Forward(const char* point, double reading) {
        carnet.Add(std::make_unique<CLectAV>(point, reading, sight), kKindLectAV);
    }
    // One set-up from `from` (height zFrom) to `to` (height zTo), the back staff read at `back`.
    void SetUp(const char* from, double zFrom, const char* to, double zTo, double back = 1.5) {
        Back(from, back);
        Forward(to, back + zFrom - zTo);
    }
    // The run A - T1 - (S) - T2 - B, B's height in the GéoBase being `zB`.
    void SimpleRun(double zB) {
        using namespace level_job;
        Benchmark("A", kA);
        Benchmark("B", zB);
        SetUp("A", kA, "T1", kT1, 1.432);
        Back("T1", 0.512);
        Forward("S", 0.512 + kT1 - kS);
        Forward("T2", 0.512 + kT1 - kT2);
        SetUp("T2", kT2, "B", kB, 2.222);
    }
};

} // namespace pyr::test
