// The fields of the elements as the editor's list view and property pages read and write them.
#include "editor/ElementFields.h"
#include "geobase/Carnet.h"

#include <cstdio>
#include <gtest/gtest.h>
#include <string>

namespace {

using pyr::CCarnet;
using pyr::FieldKey;

// One element of each kind, in the order a job has them.
CCarnet OneOfEach() {
    CCarnet carnet;
    carnet.Add(std::make_unique<pyr::CComment>("Levé du 3 mars"), pyr::kKindComment);            // 0
    carnet.Add(std::make_unique<pyr::CAppareil>("TC1", 0.0012, -0.0175), pyr::kKindAppareil);    // 1
    carnet.Add(std::make_unique<pyr::CStation>("S1", 1.562, 12.34567, "ST"), pyr::kKindStation); // 2
    carnet.Add(std::make_unique<pyr::CReference>("A1", 1.3, 323.76206, 99.40145, 260.0083),
               pyr::kKindReference);                                                                     // 3
    carnet.Add(std::make_unique<pyr::CMesure>("101", 1.3, 45.1, 100.2, 35.12, "MUR"), pyr::kKindMesure); // 4
    carnet.Add(std::make_unique<pyr::CLectAR>("R1", 1.2345, 30.0), pyr::kKindLectAR);                    // 5
    carnet.Add(std::make_unique<pyr::CLectAV>("R2", 0.9876), pyr::kKindLectAV);                          // 6
    carnet.Add(std::make_unique<pyr::CPointGen>("A1", 651050.118, 6862512.447, 95.2, "BORNE"),
               pyr::kKindPoint);                                               // 7
    carnet.Add(std::make_unique<pyr::CStation>("S2", 1.5), pyr::kKindStation); // 8
    carnet.Add(std::make_unique<pyr::CStation>("S2", 1.6), pyr::kKindStation); // 9
    auto traverse = std::make_unique<pyr::CChemin>("CH1");
    traverse->add("S1");
    traverse->add("S2(2)");
    carnet.Add(std::move(traverse), pyr::kKindChemin);                                                // 10
    carnet.Add(std::make_unique<pyr::CCommande>("ExcentRad", "0.15", "101"), pyr::kKindExcentrement); // 11
    carnet.Add(std::make_unique<pyr::CCommande>("Sym_2Pts", "1 2"), pyr::CommandKind("Sym_2Pts"));    // 12
    return carnet;
}

std::string SavedBytes(const CCarnet& carnet) {
    char* buffer = nullptr;
    std::size_t size = 0;
    std::FILE* file = open_memstream(&buffer, &size);
    carnet.Write(file);
    std::fclose(file);
    std::string bytes(buffer, size);
    std::free(buffer);
    return bytes;
}

class ElementFields : public ::testing::Test {
protected:
    void SetUp() override { pyr::SetStoreDecimals(4, 3, 5); }
    void TearDown() override { pyr::SetStoreDecimals(4, 3, 5); }

    // The edit applied to the GéoBase as the editor's document does, then the field read back.
    std::string Edited(int index, FieldKey key, std::string_view typed) {
        pyr::FieldChange change = pyr::SetFieldFromText(carnet, index, key, typed);
        EXPECT_TRUE(change) << typed << " : " << change.error;
        if (!change) return "<refusé>";
        EXPECT_TRUE(carnet.ExchangeAt(index, change.element));
        return pyr::FieldText(carnet, index, key);
    }

    CCarnet carnet = OneOfEach();
};

TEST_F(ElementFields, EveryFieldOfEveryKindReadsBackAsItIsShown) {
    // Each field's text, typed back unchanged, gives the same element: nothing is lost or reformatted.
    const std::string before = SavedBytes(carnet);
    for (int i = 0; i < carnet.GetSize(); ++i)
        for (const pyr::FieldInfo& field : pyr::KindFields(carnet.GetType(i))) {
            const std::string text = pyr::FieldText(carnet, i, field.key);
            EXPECT_EQ(Edited(i, field.key, text), text) << i << " " << field.label;
        }
    // Numbers are shown at the decimals of the options, so the values written were exact at them.
    EXPECT_EQ(SavedBytes(carnet), before);
    EXPECT_FALSE(pyr::KindFields(pyr::kKindStation).empty());
}

TEST_F(ElementFields, NumbersAreShownAtTheirDecimalsAndUndefinedOnesEmpty) {
    EXPECT_EQ(pyr::FieldText(carnet, 2, FieldKey::HI), "1.562");
    EXPECT_EQ(pyr::FieldText(carnet, 2, FieldKey::V0), "12.34567");
    EXPECT_EQ(pyr::FieldText(carnet, 7, FieldKey::X), "651050.1180");
    EXPECT_EQ(pyr::FieldText(carnet, 6, FieldKey::Distance), "");
    EXPECT_EQ(pyr::FieldText(carnet, 8, FieldKey::V0), "");
    EXPECT_EQ(pyr::FieldText(carnet, 10, FieldKey::Stations), "S1, S2(2)");
    EXPECT_EQ(pyr::FieldText(carnet, 10, FieldKey::Ferme), "Non");
    EXPECT_EQ(pyr::FieldText(carnet, 11, FieldKey::Commande), "ExcentRad");
    // A field the kind lacks, an index outside the GéoBase: nothing to show.
    EXPECT_EQ(pyr::FieldText(carnet, 0, FieldKey::X), "");
    EXPECT_EQ(pyr::FieldText(carnet, 99, FieldKey::Matricule), "");

    pyr::SetStoreDecimals(2, 1, 3);
    EXPECT_EQ(pyr::FieldText(carnet, 7, FieldKey::X), "651050.12");
    EXPECT_EQ(pyr::FieldText(carnet, 7, FieldKey::Z), "95.2");
    EXPECT_EQ(pyr::FieldText(carnet, 4, FieldKey::AV), "100.200");
}

TEST_F(ElementFields, TypedValuesAreReadTheFrenchWay) {
    EXPECT_EQ(Edited(7, FieldKey::X, "651 200,25"), "651200.2500");
    EXPECT_EQ(Edited(7, FieldKey::Y, " 6862512.4 "), "6862512.4000");
    EXPECT_EQ(Edited(7, FieldKey::Z, "-3,5"), "-3.500");
    EXPECT_EQ(Edited(2, FieldKey::HI, "1,5"), "1.500");
    EXPECT_EQ(Edited(5, FieldKey::Lecture, "1,2"), "1.2000");
    EXPECT_EQ(Edited(1, FieldKey::SigmaPpm, "2"), "2.0");
    // Identifiers are normalised as everywhere in a GéoBase.
    EXPECT_EQ(Edited(4, FieldKey::Matricule, " 0012 "), "12");
    EXPECT_EQ(Edited(10, FieldKey::Stations, "S2(2);S1  S2 (1)"), "S2(2), S1, S2");
    EXPECT_EQ(Edited(10, FieldKey::Ferme, "oui"), "Oui");
    EXPECT_EQ(Edited(7, FieldKey::InvariantZ, "O"), "Oui");
    EXPECT_EQ(Edited(3, FieldKey::Code, "Borne OGE"), "Borne OGE");
    EXPECT_EQ(Edited(0, FieldKey::Texte, "Levé\tcorrigé"), "Levé\tcorrigé");
    EXPECT_EQ(Edited(11, FieldKey::Commande, "ExcentTan"), "ExcentTan");
    // A command may name no point.
    EXPECT_EQ(Edited(11, FieldKey::Matricule, ""), "");
}

TEST_F(ElementFields, OptionalNumbersBecomeUndefinedWhenEmptied) {
    EXPECT_EQ(Edited(7, FieldKey::Z, ""), "");
    EXPECT_TRUE(carnet.As<pyr::CPointGen>(7)->is2D());
    EXPECT_EQ(Edited(2, FieldKey::V0, ""), "");
    EXPECT_EQ(carnet.v0At(2), pyr::kUndefined);
    EXPECT_EQ(Edited(4, FieldKey::DI, ""), "");
    EXPECT_EQ(Edited(4, FieldKey::AV, ""), "");
    EXPECT_EQ(Edited(5, FieldKey::Distance, ""), "");

    // X and Y go together: emptied one at a time the point would be half a planimetry, emptied
    // together (a property page) it keeps its altitude.
    pyr::FieldChange half = pyr::SetFieldFromText(carnet, 7, FieldKey::X, "");
    EXPECT_FALSE(half);
    EXPECT_EQ(half.error, "Point <A1> : X et Y doivent être donnés ensemble !");
    pyr::FieldChange both =
        pyr::SetFieldsFromText(carnet, 7, {{FieldKey::X, ""}, {FieldKey::Y, ""}, {FieldKey::Z, "12"}});
    ASSERT_TRUE(both) << both.error;
    const auto& point = static_cast<const pyr::CPointGen&>(*both.element);
    EXPECT_FALSE(point.hasXY());
    EXPECT_EQ(point.z(), 12.0);
}

TEST_F(ElementFields, RefusalsSayWhyAndLeaveTheGeoBaseAsItWas) {
    struct Case {
        int index;
        FieldKey key;
        const char* typed;
        const char* error;
    };
    const Case cases[] = {
        {7, FieldKey::X, "12a", "X : « 12a » n'est pas un nombre !"},
        {7, FieldKey::X, "1,2,3", "X : « 1,2,3 » n'est pas un nombre !"},
        {7, FieldKey::X, "6 51.2 5", "X : « 6 51.2 5 » n'est pas un nombre !"},
        {7, FieldKey::Y, "inf", "Y : « inf » n'est pas un nombre !"},
        {7, FieldKey::Z, "-999999", "Z : la valeur -999999 est réservée aux valeurs absentes !"},
        {4, FieldKey::AH, "400", "AH : 400 gr n'est pas un angle entre 0 et 400 gr !"},
        {4, FieldKey::AV, "-0,5", "AV : -0.5 gr n'est pas un angle entre 0 et 400 gr !"},
        {2, FieldKey::V0, "412", "V0 : 412 gr n'est pas un angle entre 0 et 400 gr !"},
        {4, FieldKey::DI, "-12", "DI : -12 m ne peut pas être négatif !"},
        {2, FieldKey::HI, "-1.5", "HI : -1.5 m ne peut pas être négatif !"},
        {5, FieldKey::Distance, "-3", "Distance : -3 m ne peut pas être négatif !"},
        {1, FieldKey::SigmaDi, "-0.002", "Écart type DI : -0.002 m ne peut pas être négatif !"},
        // A sighting is a direction first; a levelling reading is its reading.
        {4, FieldKey::AH, "", "AH : une valeur doit être indiquée !"},
        {5, FieldKey::Lecture, " ", "Lecture : une valeur doit être indiquée !"},
        {1, FieldKey::ConstPrisme, "", "Constante de prisme : une valeur doit être indiquée !"},
        {7, FieldKey::Matricule, "", "Le matricule du point doit être indiqué !"},
        {7, FieldKey::Matricule, "A 1", "Le matricule <A 1> n'est pas correct : il contient un espace !"},
        {2, FieldKey::Matricule, "S1,S2",
         "Le matricule <S1,S2> n'est pas correct : il contient « , », qui sépare les points d'une sélection "
         "!"},
        {7, FieldKey::Code, "BOR\tNE",
         "Code : le texte contient une tabulation ou un caractère de contrôle !"},
        {3, FieldKey::Parametres, "a\nb", "Paramètres : le texte contient un retour à la ligne !"},
        {10, FieldKey::Ferme, "peut-être", "Fermé : « peut-être » n'est ni « Oui » ni « Non » !"},
        {10, FieldKey::Stations, "S1, S3", "Stations : la station « S3 » n'existe pas dans la GéoBase !"},
        {10, FieldKey::Stations, "S2(3)", "Stations : la station « S2(3) » n'existe pas dans la GéoBase !"},
        {10, FieldKey::Stations, "S1(x)",
         "Stations : « S1(x) » ne désigne pas une station (« S1 » ou « S1(2) ») !"},
        {11, FieldKey::Commande, "Sym_2Pts",
         "Commande : « Sym_2Pts » n'est pas une commande du type ExcentRad !"},
        {12, FieldKey::Commande, "", "Commande : le mot de la commande doit être indiqué !"},
        {0, FieldKey::X, "1", "Un élément de type Commentaire n'a pas de champ « x » !"},
        {42, FieldKey::X, "1", "L'élément # 43 n'existe pas dans la GéoBase !"},
    };
    const std::string before = SavedBytes(carnet);
    for (const Case& c : cases) {
        const pyr::FieldChange change = pyr::SetFieldFromText(carnet, c.index, c.key, c.typed);
        EXPECT_FALSE(change.element) << c.typed;
        EXPECT_EQ(change.error, c.error);
    }
    EXPECT_EQ(SavedBytes(carnet), before);
}

TEST_F(ElementFields, TheWholeElementIsCheckedAsTheGeoBaseChecksWhatEntersIt) {
    // A point left without planimetry nor altitude is no point.
    ASSERT_TRUE(pyr::SetFieldFromText(carnet, 7, FieldKey::Z, ""));
    const pyr::FieldChange empty =
        pyr::SetFieldsFromText(carnet, 7, {{FieldKey::X, ""}, {FieldKey::Y, ""}, {FieldKey::Z, ""}});
    EXPECT_FALSE(empty);
    EXPECT_EQ(empty.error, "Point <A1> sans coordonnées !");
    // The first refusal of several edits is the one given, and nothing is applied.
    const pyr::FieldChange first =
        pyr::SetFieldsFromText(carnet, 4, {{FieldKey::DI, "x"}, {FieldKey::AV, "500"}});
    EXPECT_EQ(first.error, "DI : « x » n'est pas un nombre !");
    EXPECT_EQ(carnet.diAt(4), 35.12);
}

TEST_F(ElementFields, KeysKeepTheirNames) {
    for (int kind = pyr::kKindComment; kind <= pyr::kKindLastCommand; ++kind)
        for (const pyr::FieldInfo& field : pyr::KindFields(kind)) {
            const std::string_view name = pyr::FieldKeyName(field.key);
            ASSERT_FALSE(name.empty());
            EXPECT_EQ(pyr::FieldKeyFromName(name), field.key) << name;
            EXPECT_EQ(pyr::FindField(kind, field.key), &field);
            EXPECT_EQ(pyr::FieldDecimals(kind, field.key) >= 0, field.type == pyr::FieldType::Number) << name;
        }
    EXPECT_EQ(pyr::FieldKeyFromName("AH"), FieldKey::AH);
    EXPECT_FALSE(pyr::FieldKeyFromName("azimut"));
}

} // namespace
