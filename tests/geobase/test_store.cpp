// The store's arrays, accessors and look-ups, on small GéoBases built in each test.
#include "geobase/Carnet.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <map>
#include <memory>
#include <set>
#include <string>
#include <vector>

using namespace pyr;

namespace {

// Two set-ups of S1 around one of S2, with the points they sight.
CCarnet SmallJob() {
    CCarnet c;
    c.Add(std::make_unique<CAppareil>("TCR 705", 0.0012, -0.0175), kKindAppareil); // 0
    c.Add(std::make_unique<CPointGen>("S1", 1000.0, 2000.0, 100.0), kKindPoint);   // 1
    c.Add(std::make_unique<CPointGen>("A1", 0.0, 0.0, "BORNE"), kKindPoint);       // 2: X = Y = 0 is a place
    c.Add(std::make_unique<CStation>("S1", 1.55), kKindStation);                   // 3
    c.Add(std::make_unique<CReference>("A1", 1.3, 12.5, 100.2, 250.0), kKindReference); // 4
    c.Add(std::make_unique<CMesure>("P7", 1.3, 212.5, 99.8, 35.0), kKindMesure);        // 5
    c.Add(std::make_unique<CStation>("S2", 1.60, 0.0), kKindStation);                   // 6: V0 = 0 is known
    c.Add(std::make_unique<CMesure>("P7", 1.3, 5.0, 100.0, 40.0), kKindMesure);         // 7
    c.Add(std::make_unique<CAppareil>("TS 15"), kKindAppareil);                         // 8
    c.Add(std::make_unique<CStation>("S1", 1.48), kKindStation);                        // 9
    c.Add(std::make_unique<CMesure>("P7", kUndefined, 300.0, kUndefined, kUndefined), kKindMesure); // 10
    c.Add(std::make_unique<CPointGen>("P7", 57.25), kKindPoint); // 11: altitude only
    return c;
}

void ExpectInStep(const CCarnet& c) {
    for (int i = 0; i < c.GetSize(); ++i) {
        ASSERT_NE(c.GetAt(i), nullptr);
        EXPECT_TRUE(ElementFitsKind(*c.GetAt(i), c.GetType(i))) << "index " << i;
    }
    EXPECT_EQ(c.GetAt(c.GetSize()), nullptr);
}

} // namespace

TEST(Store, TheKindArrayStaysInStepWithTheElements) {
    CCarnet c = SmallJob();

    // An element that cannot stand under a kind is refused, and nothing is appended.
    EXPECT_EQ(c.Add(std::make_unique<CPointGen>("X", 1.0, 2.0), kKindMesure), -1);
    EXPECT_EQ(c.Add(std::make_unique<CCommande>("Sym_2Pts"), 1999), -1);
    EXPECT_EQ(c.Add(nullptr, kKindComment), -1);

    EXPECT_EQ(c.Add(std::make_unique<CCommande>("ExcentRad", "0.15"), kKindExcentrement), 12);
    EXPECT_EQ(c.InsertAt(0, std::make_unique<CComment>("en-tête"), kKindComment), 0);
    c.removeElement(0);
    c.RemoveRange(3, 6); // S1(1) with its two sightings
    EXPECT_EQ(c.GetSize(), 10);
    EXPECT_EQ(c.matAt(3), "S2");
    ExpectInStep(c);

    // A sighting changes kind by changing class; commands change kind in place.
    ASSERT_TRUE(c.SetKindAt(4, kKindReference));
    EXPECT_EQ(c.As<CReference>(4)->ah(), 5.0);
    EXPECT_FALSE(c.SetKindAt(4, kKindPoint));
    EXPECT_TRUE(c.SetKindAt(9, 1025));
    EXPECT_EQ(c.GetType(9), 1025);
    EXPECT_EQ(c.Add(c.copyElement(4), kKindReference), 10); // a copy is the caller's to keep

    CCarnet other;
    other.Add(std::make_unique<CComment>("a"), kKindComment);
    other.Add(std::make_unique<CPointGen>("Z9", 1.0), kKindPoint);
    c.Append(std::move(other));
    EXPECT_EQ(c.findMat("Z9"), 12);
    ExpectInStep(c);
}

TEST(Store, TheUndefinedValueIsMissingEverywhereAndZeroIsAValue) {
    CCarnet c = SmallJob();
    double x = -1, y = -1, z = -1;
    EXPECT_TRUE(c.hasXY("A1", x, y) && x == 0.0 && y == 0.0);
    EXPECT_FALSE(c.hasZ("A1"));
    EXPECT_TRUE(c.hasZ("P7", z) && z == 57.25);
    EXPECT_FALSE(c.hasXY("P7"));
    EXPECT_EQ(c.zFor(5), 57.25); // the point a sighting names

    EXPECT_EQ(c.v0At(6), 0.0);
    EXPECT_EQ(c.v0At(3), kUndefined);  // a new station is not oriented
    EXPECT_EQ(c.dhAt(10), kUndefined); // no zenith angle, no horizontal distance
    EXPECT_NEAR(c.dhAt(4), 250.0 * std::sin(100.2 * 3.14159265358979323846 / 200.0), 1e-9);

    // What an element does not have reads as missing, whatever the accessor.
    EXPECT_EQ(c.xAt(3), kUndefined);
}

TEST(Store, ReprisesAreFoundByTheirNumber) {
    CCarnet c = SmallJob();
    EXPECT_EQ(c.findStaRep("S1", 2), 9);
    EXPECT_EQ(c.findStaRep("S1", 3), -1);
    // The rank of a set-up among those on its point: the point and the sightings named S1 do not count.
    for (auto [index, reprise] : {std::pair{3, 1}, {9, 2}, {6, 1}, {4, 0}, {1, 0}})
        EXPECT_EQ(c.RepriseAt(index), reprise) << index;
    EXPECT_EQ(c.StationDesignation(9), "S1(2)");
    const int unnamed = c.Add(std::make_unique<CStation>("", 1.5), kKindStation);
    EXPECT_EQ(c.RepriseAt(unnamed), 1);

    // "S1(2)", or a bare name for its first set-up; the reprise counts from 1.
    auto split = [](const char* text) {
        std::string name;
        int reprise = 0;
        return CCarnet::extrStaRep(text, name, reprise) ? name + "/" + std::to_string(reprise) : "refusé";
    };
    EXPECT_EQ(split(" 1005 (3) "), "1005/3");
    EXPECT_EQ(split("S7"), "S7/1");
    for (const char* refused : {"S1(x)", "S1(0)", "(2)"})
        EXPECT_EQ(split(refused), "refusé") << refused;

    // Each sighting belongs to the station before it.
    std::string name;
    EXPECT_EQ(c.findRepAt(5, name), 3);
    EXPECT_EQ(name, "S1");
    EXPECT_EQ(c.findRepAt(2, name), -1);

    CChemin traverse("POLY");
    EXPECT_TRUE(traverse.add(9, c));
    EXPECT_FALSE(traverse.add(10, c));
    EXPECT_EQ(traverse.stations(), std::vector<std::string>{"S1(2)"});
}

TEST(Store, FindSearchesBothWaysAndAnEmptyNameMatchesTheWholeKind) {
    CCarnet c = SmallJob();
    EXPECT_EQ(c.Find(kKindMesure, "P7"), 5);
    EXPECT_EQ(c.Find(kKindMesure, "P7", 11, -1), 10);
    EXPECT_EQ(c.Find(kKindMesure, "P7", 100, -1), 10); // a start past the end is the end
    EXPECT_EQ(c.Find(kKindStation, "", 4), 6);
    EXPECT_EQ(c.Find(kKindStation, "NONE"), -1);
    EXPECT_EQ(c.findMat("P7"), 11);
    EXPECT_EQ(c.findMat("S2"), -1); // a station is not a known point
    EXPECT_FALSE(c.hasPnt(10));
}

TEST(Store, TheIndexFollowsAppendsRemovalsAndRenaming) {
    CCarnet c = SmallJob();
    EXPECT_EQ(c.findMat("P7"), 11); // builds the index
    c.Add(std::make_unique<CPointGen>("P8", 1.0, 2.0, 3.0), kKindPoint);
    EXPECT_EQ(c.findMat("P8"), 12);
    c.removeElement(0);
    EXPECT_EQ(c.findMat("P8"), 11);

    // Renamed through a pointer, without the store knowing.
    c.GetAt(11)->setMat("P8bis");
    EXPECT_EQ(c.findMat("P8"), -1);
    EXPECT_EQ(c.findMat("P8bis"), 11);
    EXPECT_EQ(c.SameMat(11), std::vector<int>{11});

    // A deep copy has its own index.
    CCarnet copy = c;
    copy.removeElement(0);
    EXPECT_EQ(copy.findMat("P8bis"), 10);
    EXPECT_EQ(c.findMat("P8bis"), 11);
    copy.GetAt(0)->setMat("changed");
    EXPECT_EQ(c.matAt(1), "A1");
}

TEST(Store, AnElementIsExchangedInPlaceUnderItsOwnKindWithoutACopy) {
    CCarnet c = SmallJob();
    EXPECT_EQ(c.findMat("A1"), 2); // builds the index
    std::unique_ptr<CElement> element = std::make_unique<CPointGen>("A2", 5.0, 6.0);
    const CElement* given = element.get();
    const CElement* held = c.GetAt(2);
    ASSERT_TRUE(c.ExchangeAt(2, element));
    EXPECT_EQ(c.GetAt(2), given);
    EXPECT_EQ(element.get(), held); // handed back as it was
    EXPECT_EQ(c.xAt(2), 5.0);
    EXPECT_EQ(c.findMat("A2"), 2);
    EXPECT_EQ(c.findMat("A1"), -1);
    // The element put in is the store's: renamed through a pointer, the index follows.
    c.GetAt(2)->setMat("A4");
    EXPECT_EQ(c.findMat("A4"), 2);

    // Refused, and nothing exchanged: another kind's class, an index outside the store, no element.
    std::unique_ptr<CElement> station = std::make_unique<CStation>("S9", 1.5);
    EXPECT_FALSE(c.ExchangeAt(2, station));
    EXPECT_FALSE(c.ExchangeAt(c.GetSize(), element));
    EXPECT_FALSE(c.ExchangeAt(-1, element));
    std::unique_ptr<CElement> none;
    EXPECT_FALSE(c.ExchangeAt(2, none));
    EXPECT_EQ(station->mat(), "S9");
    EXPECT_EQ(element.get(), held);
    EXPECT_EQ(c.GetAt(2), given);
    ExpectInStep(c);
}

TEST(Store, WhetherAStationIsThereFollowsEveryChange) {
    CCarnet c;
    c.Add(std::make_unique<CPointGen>("A1", 1.0, 2.0), kKindPoint);
    EXPECT_FALSE(c.HasStation());
    c.Add(std::make_unique<CStation>("S1", 1.5), kKindStation);
    EXPECT_TRUE(c.HasStation()); // appended after a search that found none
    c.removeElement(1);
    EXPECT_FALSE(c.HasStation());
    c.Add(std::make_unique<CPointGen>("A2", 1.0, 2.0), kKindPoint);
    c.InsertAt(0, std::make_unique<CStation>("S2", 1.5), kKindStation);
    EXPECT_TRUE(c.HasStation()); // inserted before the part already searched
    c.removeElement(0);
    c.InsertAt(1, std::make_unique<CStation>("S3", 1.5), kKindStation); // where the last one was seen
    EXPECT_TRUE(c.HasStation());
    c.RemoveAll();
    EXPECT_FALSE(c.HasStation());
}

TEST(Store, InstrumentsAndEccentricOffsetsApplyToWhatFollowsThem) {
    CCarnet c;
    c.Add(std::make_unique<CCommande>("ExcentVer", "0.12"), kKindExcentrement);     // 0
    c.Add(std::make_unique<CStation>("S1", 1.5), kKindStation);                     // 1
    c.Add(std::make_unique<CCommande>("excentrad", " -0.25 m"), kKindExcentrement); // 2
    c.Add(std::make_unique<CCommande>("ExcentTan", "0.05"), kKindExcentrement);     // 3
    c.Add(std::make_unique<CCommande>("Sym_2Pts", "1 2"), 1025);                    // 4
    c.Add(std::make_unique<CMesure>("P1", 1.3, 10.0, 100.0, 20.0), kKindMesure);    // 5
    c.Add(std::make_unique<CMesure>("P2", 1.3, 20.0, 100.0, 30.0), kKindMesure);    // 6

    EXPECT_EQ(c.findER(5, 0), -0.25); // letter case of the word does not matter
    EXPECT_EQ(c.findET(5, 0), 0.05);
    EXPECT_EQ(c.findEV(5, 0), 0.0);   // the station's own offset stops at the station
    EXPECT_EQ(c.findER(6, 0), 0.0);   // only the sighting right after the offsets
    EXPECT_EQ(c.findEV(1, -1), 0.12); // the station itself
    EXPECT_EQ(c.findER(5, 3), 0.0);   // not below the limit

    EXPECT_EQ(c.findAppAt(5), nullptr); // none: the caller takes the one of its options
    const CCarnet job = SmallJob();
    EXPECT_EQ(job.findAppAt(7)->mat(), "TCR 705");
    EXPECT_EQ(job.findAppAt(10)->mat(), "TS 15");

    EXPECT_TRUE(c.isObsAltiAt(5, 1));
    c.As<CMesure>(6)->setHP(kUndefined);
    EXPECT_FALSE(c.isObsAltiAt(6, 1));
}

TEST(Store, ComputedPointsAreRoundedToTheDecimalsSettings) {
    SetStoreDecimals(3, 2, 4);
    CPointGen p("P1", 1.0, 2.0, 3.0);
    EXPECT_TRUE(p.setPt(651325.41249, 6862371.90551, 53.8749));
    EXPECT_EQ(p.x(), 651325.412);
    EXPECT_EQ(p.z(), 53.87);
    EXPECT_TRUE(p.setPt(12.3456, true)); // the altitude alone, held fixed
    EXPECT_EQ(p.z(), 12.35);
    EXPECT_TRUE(p.invariantZ() && !p.invariantXY());
    EXPECT_FALSE(p.setPt(std::nan(""), 1.0));
    EXPECT_EQ(p.x(), 651325.412);
    EXPECT_EQ(CCarnet::formatAng(123.456789), 123.4568);
    SetStoreDecimals(4, 3, 5);
}

// The index grows as a reader appends: thousands of identifiers, short and long ones that share their first
// sixteen bytes, looked up between the appends, every answer the same as a scan of the elements gives.
TEST(Store, TheIndexAnswersLikeAScanWhileItGrowsUnderAppends) {
    CCarnet c;
    auto name = [](int n) {
        // Long names differ only past the bytes an index line holds.
        return n % 3 == 0 ? "TRES_LONG_PREFIXE_" + std::to_string(n) : "P" + std::to_string(n % 1500);
    };
    auto scan = [&c](int kind, const std::string& mat, int start, int direction) {
        if (direction == 0) {
            for (int i = std::max(start, 0); i < c.GetSize(); ++i)
                if (c.GetType(i) == kind && c.matAt(i) == mat) return i;
        } else {
            for (int i = std::min(start, c.GetSize() - 1); i >= 0; --i)
                if (c.GetType(i) == kind && c.matAt(i) == mat) return i;
        }
        return -1;
    };
    for (int n = 0; n < 6000; ++n) {
        if (n % 2 == 0)
            c.Add(std::make_unique<CPointGen>(name(n), n, n, n), kKindPoint);
        else
            c.Add(std::make_unique<CMesure>(name(n), 1.3, 10.0, 100.0, n), kKindMesure);
        if (n % 997 != 0) continue;
        for (int probe = 0; probe <= n; probe += 7) {
            const std::string mat = name(probe);
            ASSERT_EQ(c.Find(kKindPoint, mat), scan(kKindPoint, mat, 0, 0)) << mat;
            ASSERT_EQ(c.Find(kKindMesure, mat, n / 2, -1), scan(kKindMesure, mat, n / 2, -1)) << mat;
        }
    }
    // Every element finds the others of its identifier, and one rank per identifier, without a search.
    std::map<std::string, std::vector<int>> byName;
    for (int i = 0; i < c.GetSize(); ++i)
        byName[c.matAt(i)].push_back(i);
    std::set<int> ranks;
    for (const auto& [mat, indices] : byName) {
        const int rank = c.NameRank(indices.front());
        EXPECT_TRUE(ranks.insert(rank).second) << mat;
        EXPECT_LT(rank, c.NameCount());
        for (int i : indices) {
            ASSERT_EQ(c.NameRank(i), rank) << mat;
            ASSERT_EQ(c.SameMat(i), indices) << mat;
        }
    }
    EXPECT_EQ(c.NameCount(), static_cast<int>(byName.size()));
    EXPECT_EQ(c.NameRank(c.GetSize()), -1);
    EXPECT_TRUE(c.SameMat(-1).empty());
    EXPECT_EQ(c.Find(kKindPoint, "TRES_LONG_PREFIXE_"), -1);
    EXPECT_EQ(c.Find(kKindPoint, "TRES_LONG_PREFIXE_5997"), -1); // a measure, not a point
    EXPECT_EQ(c.findMat("TRES_LONG_PREFIXE_5994"), 5994);
}

// The editor inserts, removes and exchanges elements one at a time in a store of a million: the index
// follows those edits instead of being built again, and must answer as one built from scratch would,
// ranks included (a traverse search numbers what it finds in the order of the ranks).
TEST(Store, TheIndexKeptThroughInsertionsRemovalsAndExchangesAnswersLikeANewOne) {
    CCarnet c;
    auto name = [](unsigned n) {
        return n % 5 == 0 ? "TRES_LONG_PREFIXE_" + std::to_string(n % 40) : "P" + std::to_string(n % 60);
    };
    for (unsigned n = 0; n < 400; ++n) {
        if (n % 7 == 0)
            c.Add(std::make_unique<CComment>("remarque"), kKindComment);
        else if (n % 2 == 0)
            c.Add(std::make_unique<CPointGen>(name(n), n, n, n), kKindPoint);
        else
            c.Add(std::make_unique<CMesure>(name(n), 1.3, 10.0, 100.0, n), kKindMesure);
    }
    unsigned seed = 12345;
    auto next = [&seed] { return seed = seed * 1103515245u + 12345u, (seed >> 8) % 100000; };
    std::vector<std::unique_ptr<CElement>> held; // what the edits took out, alive as in a history
    for (int edit = 0; edit < 600; ++edit) {
        if (edit % 50 == 0) c.findMat("P1"); // the index built, then kept through what follows
        const int at = static_cast<int>(next() % static_cast<unsigned>(c.GetSize()));
        switch (next() % 3) {
        case 0: {
            const unsigned n = next();
            if (n % 4 == 0)
                c.InsertAt(at, std::make_unique<CComment>("ajout"), kKindComment);
            else
                c.InsertAt(at, std::make_unique<CMesure>(name(n), 1.5, 20.0, 100.0, 5.0), kKindMesure);
            break;
        }
        case 1: {
            int kind = 0;
            held.push_back(c.TakeAt(at, kind));
            break;
        }
        default: {
            // Its new state, under the same identifier most often, as a moved point or an edited reading.
            std::unique_ptr<CElement> other = c.copyElement(at);
            if (next() % 5 == 0 && !other->mat().empty()) other->setMat(name(next()));
            c.ExchangeAt(at, other);
            held.push_back(std::move(other));
        }
        }
        if (edit % 7 != 0) continue;
        const CCarnet fresh = c; // a copy builds its own index
        ASSERT_EQ(c.NameCount(), fresh.NameCount()) << "edit " << edit;
        for (int i = 0; i < c.GetSize(); ++i) {
            ASSERT_EQ(c.NameRank(i), fresh.NameRank(i)) << "edit " << edit << ", element " << i;
            ASSERT_EQ(c.SameMat(i), fresh.SameMat(i)) << "edit " << edit << ", element " << i;
            ASSERT_EQ(c.Find(c.GetType(i), "", i), i) << "edit " << edit << ", element " << i;
        }
        ASSERT_EQ(c.Find(kKindComment, "", 0), fresh.Find(kKindComment, "", 0));
        ASSERT_EQ(c.findMat("TRES_LONG_PREFIXE_0"), fresh.findMat("TRES_LONG_PREFIXE_0"));
    }
    held.clear(); // the views of the identifiers must not have followed the elements taken out
    const CCarnet fresh = c;
    for (int i = 0; i < c.GetSize(); ++i)
        ASSERT_EQ(c.SameMat(i), fresh.SameMat(i)) << "element " << i;
    for (unsigned n = 0; n < 60; ++n)
        ASSERT_EQ(c.findMat(name(n)), fresh.findMat(name(n))) << name(n);

    // The first element of a long identifier exchanged, and its former state let go.
    const int first = c.findMat("TRES_LONG_PREFIXE_10");
    ASSERT_GE(first, 0);
    std::unique_ptr<CElement> moved = c.copyElement(first);
    ASSERT_TRUE(c.ExchangeAt(first, moved));
    moved.reset();
    EXPECT_EQ(c.findMat("TRES_LONG_PREFIXE_10"), first);
}
