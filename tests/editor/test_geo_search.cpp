// The editor's search of a GéoBase and its "Chercher suivant".
#include "editor/GeoSearch.h"
#include "geobase/Carnet.h"

#include <gtest/gtest.h>

namespace {

using pyr::CCarnet;
using pyr::CompareOp;
using pyr::FieldKey;
using pyr::SearchCriteria;
using Indices = std::vector<int>;

CCarnet Job() {
    CCarnet carnet;
    carnet.Add(std::make_unique<pyr::CComment>("Levé du 3 mars"), pyr::kKindComment); // 0
    carnet.Add(std::make_unique<pyr::CPointGen>("100", 1000.0, 2000.0, 102.3504, "BORNE"),
               pyr::kKindPoint); // 1
    carnet.Add(std::make_unique<pyr::CPointGen>("101", 1010.0, 2000.0, 102.3506, "borne"),
               pyr::kKindPoint);                                                                        // 2
    carnet.Add(std::make_unique<pyr::CStation>("S1", 1.5), pyr::kKindStation);                          // 3
    carnet.Add(std::make_unique<pyr::CReference>("100", 1.3, 12.0, 100.0, 10.0), pyr::kKindReference);  // 4
    carnet.Add(std::make_unique<pyr::CMesure>("P7", 1.3, 50.0, 98.0, 20.0, "BORNE"), pyr::kKindMesure); // 5
    carnet.Add(std::make_unique<pyr::CMesure>("102", 1.3, 60.0, 99.0, 30.0), pyr::kKindMesure);         // 6
    carnet.Add(std::make_unique<pyr::CPointGen>("P-12", 103.1), pyr::kKindPoint);                       // 7
    carnet.Add(std::make_unique<pyr::CStation>("100", 1.6), pyr::kKindStation);                         // 8
    carnet.Add(std::make_unique<pyr::CMesure>("S1", 1.3, 0.0, 100.0, 52.0), pyr::kKindMesure);          // 9
    carnet.Add(std::make_unique<pyr::CCommande>("ExcentRad", "0.2", "100"), pyr::kKindExcentrement);    // 10
    return carnet;
}

class GeoSearch : public ::testing::Test {
protected:
    void SetUp() override { pyr::SetStoreDecimals(4, 3, 5); }
    void TearDown() override { pyr::SetStoreDecimals(4, 3, 5); }

    Indices Found(const SearchCriteria& criteria, int from = 0) {
        return pyr::Search(carnet, criteria, from);
    }
    static SearchCriteria Ids(std::string text) {
        SearchCriteria criteria;
        criteria.identifiers = std::move(text);
        return criteria;
    }
    static SearchCriteria Value(FieldKey key, CompareOp op, double value) {
        SearchCriteria criteria;
        criteria.value = pyr::ValueCriterion{key, op, value};
        return criteria;
    }

    CCarnet carnet = Job();
};

TEST_F(GeoSearch, AnIdentifierFindsEveryElementBearingItWhateverItsKind) {
    EXPECT_EQ(Found(Ids("100")), (Indices{1, 4, 8, 10}));
    EXPECT_EQ(Found(Ids(" 0100 ")), (Indices{1, 4, 8, 10})); // read as the GéoBase writes it
    EXPECT_EQ(Found(Ids("100"), 5), (Indices{8, 10}));
    EXPECT_EQ(Found(Ids("P-12")), (Indices{7})); // a dash inside an identifier is no range
    EXPECT_EQ(Found(Ids("p7")), Indices{});      // letter case counts
    EXPECT_EQ(Found(Ids("999")), Indices{});

    SearchCriteria stations = Ids("100");
    stations.kinds = {pyr::kKindStation, pyr::kKindPoint};
    EXPECT_EQ(Found(stations), (Indices{1, 8}));
}

TEST_F(GeoSearch, ASelectionFindsItsRangesAndIdentifiers) {
    EXPECT_EQ(Found(Ids("100-101, S1")), (Indices{1, 2, 3, 4, 8, 9, 10}));
    EXPECT_EQ(Found(Ids("101-102; P7")), (Indices{2, 5, 6}));

    const SearchCriteria reversed = Ids("150-100");
    EXPECT_EQ(pyr::SearchCriteriaError(reversed),
              "La sélection de matricules n'est pas correcte : « 150-100 » : plage à l'envers, le premier "
              "numéro est plus grand que le dernier !");
    EXPECT_EQ(Found(reversed), Indices{});
    EXPECT_EQ(pyr::FindNext(carnet, reversed, 0), -1);
    EXPECT_EQ(pyr::SearchCriteriaError(Ids("100-101, S1")), "");
}

TEST_F(GeoSearch, CodesAreComparedExactlyAndKindsCombine) {
    SearchCriteria code;
    code.code = "BORNE";
    EXPECT_EQ(Found(code), (Indices{1, 5}));
    code.kinds = {pyr::kKindMesure};
    EXPECT_EQ(Found(code), (Indices{5}));
    code.identifiers = "100-200";
    EXPECT_EQ(Found(code), Indices{});

    SearchCriteria kinds;
    kinds.kinds = {pyr::kKindStation, pyr::kKindComment};
    EXPECT_EQ(Found(kinds), (Indices{0, 3, 8}));
    EXPECT_EQ(Found(SearchCriteria{}).size(), static_cast<std::size_t>(carnet.GetSize()));
}

TEST_F(GeoSearch, ValuesAreComparedAtTheDecimalsTheyAreShownWith) {
    // Z shown with 3 decimals: 102.3504 is 102.350, 102.3506 is 102.351.
    EXPECT_EQ(Found(Value(FieldKey::Z, CompareOp::Equal, 102.35)), (Indices{1}));
    EXPECT_EQ(Found(Value(FieldKey::Z, CompareOp::Greater, 102.35)), (Indices{2, 7}));
    EXPECT_EQ(Found(Value(FieldKey::Z, CompareOp::Less, 102.351)), (Indices{1}));
    // Kinds without the field, and undefined values, never match: the altitude-only point has no X.
    EXPECT_EQ(Found(Value(FieldKey::X, CompareOp::Less, 1e9)), (Indices{1, 2}));
    EXPECT_EQ(Found(Value(FieldKey::DI, CompareOp::Greater, 15.0)), (Indices{5, 6, 9}));

    pyr::SetStoreDecimals(4, 2, 5);
    EXPECT_EQ(Found(Value(FieldKey::Z, CompareOp::Equal, 102.35)), (Indices{1, 2}));
}

TEST_F(GeoSearch, FindNextGoesRoundBothWays) {
    SearchCriteria measured;
    measured.kinds = {pyr::kKindMesure};
    EXPECT_EQ(pyr::FindNext(carnet, measured, 5), 6);
    EXPECT_EQ(pyr::FindNext(carnet, measured, 9), 5); // past the end, from the beginning
    EXPECT_EQ(pyr::FindNext(carnet, measured, 5, false), 9);
    EXPECT_EQ(pyr::FindNext(carnet, measured, 7, false), 6);
    EXPECT_EQ(pyr::FindNext(carnet, measured, -1), 5);
    EXPECT_EQ(pyr::FindNext(carnet, measured, -1, false), 9);

    // The same through the elements of one identifier.
    const SearchCriteria id = Ids("100");
    EXPECT_EQ(pyr::FindNext(carnet, id, 1), 4);
    EXPECT_EQ(pyr::FindNext(carnet, id, 5), 8);
    EXPECT_EQ(pyr::FindNext(carnet, id, 10), 1);
    EXPECT_EQ(pyr::FindNext(carnet, id, 1, false), 10);
    EXPECT_EQ(pyr::FindNext(carnet, id, 5, false), 4);
    EXPECT_EQ(pyr::FindNext(carnet, id, 99, false), 10);

    // The only match is found again from itself; nothing found gives -1.
    EXPECT_EQ(pyr::FindNext(carnet, Ids("P7"), 5), 5);
    EXPECT_EQ(pyr::FindNext(carnet, Ids("P7"), 5, false), 5);
    EXPECT_EQ(pyr::FindNext(carnet, Ids("999"), 0), -1);
    EXPECT_EQ(pyr::FindNext(CCarnet(), measured, 0), -1);
}

TEST_F(GeoSearch, TheIndexFollowsTheGeoBaseAsItChanges) {
    EXPECT_EQ(Found(Ids("P7")), (Indices{5}));
    carnet.GetAt(6)->setMat("P7");
    carnet.removeElement(0);
    EXPECT_EQ(Found(Ids("P7")), (Indices{4, 5}));
}

} // namespace
