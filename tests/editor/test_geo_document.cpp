// A GéoBase open in the editor, edited through its document: every edit, undone, gives back the bytes
// the GéoBase had, and redone, those it had after it; the file is said modified exactly when it differs
// from what was saved; a modified GéoBase is not closed without the person's word.
#include "TestSupport.h"
#include "editor/GeoDocument.h"
#include "geobase/Carnet.h"
#include "ui/ScriptedFrontEnd.h"

#include <functional>
#include <gtest/gtest.h>

namespace pyr {
namespace {

constexpr const char* kGeo = "GEOBASE PYRALIS\t1\n"
                             "1000\tLevé du 3 mars\n"
                             "1006\tA1\t651050.118\t6862512.447\t55.021\tXYZ\tBORNE\n"
                             "1006\tA2\t651412.65\t6862598.3\t58.44\tXYZ\tBORNE\n"
                             "1001\tS1\t1.562\t37.123401\n"
                             "1002\tA1\t1.3\t323.76206\t99.40145\t260.0083\n"
                             "1002\tA2\t1.3\t2.30331\t98.98188\t366.384\n"
                             "1003\t100\t1.3\t16.85792\t99.63359\t83.3186\tANGLE BAT\n";

class Document : public ::testing::Test {
protected:
    void SetUp() override {
        WriteBytes(dir / "a.geo", kGeo);
        ASSERT_TRUE(document.Open(frontEnd, dir / "a.geo"));
        original = Bytes();
    }
    // What the GéoBase would be saved as now.
    std::string Bytes() {
        CCarnet copy = document.Carnet();
        EXPECT_EQ(copy.Save(dir / "copie.geo"), 1);
        return ReadBytes(dir / "copie.geo");
    }
    // The edit made, then undone and redone: the bytes before, then after it, each time.
    void ExpectUndoable(const std::function<bool()>& edit) {
        const std::string before = Bytes();
        ASSERT_TRUE(edit());
        const std::string after = Bytes();
        EXPECT_NE(after, before);
        ASSERT_TRUE(document.Undo());
        EXPECT_EQ(Bytes(), before);
        ASSERT_TRUE(document.Redo());
        EXPECT_EQ(Bytes(), after);
    }

    TempDir dir;
    ui::ScriptedFrontEnd frontEnd;
    CGeoDocument document;
    std::string original;
};

TEST_F(Document, EveryEditUndoneGivesTheBytesBackAndRedoneGivesItsOwn) {
    ExpectUndoable([&] {
        ElementReplacements moved;
        auto point = document.Carnet().copyElement(1);
        static_cast<CPointGen&>(*point).setPt(651050.5, 6862512.0);
        moved.push_back({1, std::move(point)});
        return document.Replace("", std::move(moved));
    });
    ExpectUndoable(
        [&] { return document.Insert(3, std::make_unique<CPointGen>("B7", 10.0, 20.0, 30.0), kKindPoint); });
    ExpectUndoable([&] { return document.Remove({5, 1, 6}); });
    ExpectUndoable([&] { return document.Move(1, 4); });
    ExpectUndoable([&] { return document.Move(4, 0); });
    ExpectUndoable([&] { return document.Disable(frontEnd, 3); });
    ExpectUndoable([&] { return document.Enable(frontEnd, 3); });
    ExpectUndoable([&] {
        ElementChanges changes;
        auto point = std::make_unique<CPointGen>("A2", 1.0, 2.0, 3.0);
        std::unique_ptr<CElement> other = std::move(point);
        // A2, now first, moved in place as the change of frame moves points.
        if (!document.Store().ExchangeAt(0, other)) return false;
        changes.push_back({0, std::move(other)});
        document.RecordChanges("Changement de repère", std::move(changes));
        return true;
    });

    // All of them undone: the GéoBase as it was read; all of them redone: as they left it.
    const std::string last = Bytes();
    while (document.CanUndo())
        ASSERT_TRUE(document.Undo());
    EXPECT_EQ(Bytes(), original);
    while (document.CanRedo())
        ASSERT_TRUE(document.Redo());
    EXPECT_EQ(Bytes(), last);
}

TEST_F(Document, WhatCannotBeDoneChangesNothing) {
    ElementReplacements wrongKind;
    wrongKind.push_back({4, std::make_unique<CPointGen>("A1", 1.0, 2.0)}); // a sighting stands there
    wrongKind.push_back({1, std::make_unique<CPointGen>("A1", 1.0, 2.0)});
    EXPECT_FALSE(document.Replace("", std::move(wrongKind)));
    EXPECT_FALSE(document.Remove({2, 99}));
    EXPECT_FALSE(document.Move(0, 99));
    EXPECT_FALSE(document.Insert(99, std::make_unique<CComment>("x"), kKindComment));
    EXPECT_FALSE(document.Disable(frontEnd, 0)); // already a comment
    EXPECT_FALSE(document.Enable(frontEnd, 1));  // not a comment
    EXPECT_EQ(Bytes(), original);
    EXPECT_FALSE(document.CanUndo());
    EXPECT_FALSE(document.Modified());
}

// A point deleted is that element only: the sightings of it are observations and stay.
TEST_F(Document, DeletingAPointLeavesItsSightings) {
    ASSERT_TRUE(document.Remove({1}));
    EXPECT_LT(document.Carnet().findMat("A1"), 0);
    EXPECT_EQ(document.Carnet().Find(kKindReference, "A1"), 3);
}

TEST_F(Document, ModifiedUntilSavedAndAgainWhenTheSavedStateIsUndone) {
    EXPECT_FALSE(document.Modified());
    ASSERT_TRUE(document.Remove({0}));
    EXPECT_TRUE(document.Modified());
    ASSERT_TRUE(document.Undo());
    EXPECT_FALSE(document.Modified());
    ASSERT_TRUE(document.Redo());
    ASSERT_TRUE(document.Save(frontEnd));
    EXPECT_FALSE(document.Modified());
    EXPECT_EQ(ReadBytes(dir / "a.geo"), Bytes());
    ASSERT_TRUE(document.Undo());
    EXPECT_TRUE(document.Modified());
    EXPECT_EQ(document.RedoLabel(), "Suppression de 1 élément(s)");
}

TEST_F(Document, AModifiedGeoBaseIsClosedOnlyOnThePersonsWord) {
    ASSERT_TRUE(document.Remove({0}));
    frontEnd.answers = {ui::Answer::Cancel};
    EXPECT_FALSE(document.CanClose(frontEnd));
    frontEnd.answers = {ui::Answer::No};
    EXPECT_TRUE(document.CanClose(frontEnd));
    EXPECT_EQ(ReadBytes(dir / "a.geo"), kGeo);
    frontEnd.answers = {ui::Answer::Yes};
    EXPECT_TRUE(document.CanClose(frontEnd));
    EXPECT_EQ(ReadBytes(dir / "a.geo"), Bytes());
    EXPECT_EQ(frontEnd.questions.size(), 3u);
}

TEST_F(Document, TheSelectionHoldsElementsAndIsDroppedWhenTheirPlacesChange) {
    document.Select({6, 2, 2, 99, -1});
    EXPECT_EQ(document.Selection(), (std::vector<int>{2, 6}));
    ElementReplacements renamed;
    renamed.push_back({2, std::make_unique<CPointGen>("A9", 1.0, 2.0)});
    ASSERT_TRUE(document.Replace("", std::move(renamed)));
    EXPECT_EQ(document.Selection(), (std::vector<int>{2, 6})); // the same elements still
    ASSERT_TRUE(document.Remove({0}));
    EXPECT_TRUE(document.Selection().empty());
}

} // namespace
} // namespace pyr
