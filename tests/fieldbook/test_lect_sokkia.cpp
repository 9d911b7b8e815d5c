// SDR2x and SDR33 field books read into GéoBases. The field books tests/data/fieldbook/sokkia-*.sdr were
// written for these tests from the record layouts; their geometry is constructed: station S1 at
// E 1000, N 2000, Z 100 with an instrument height of 1.550, its backsight A1 100 m to the east (azimuth
// 100 gr) read at 50 gr on the circle. Every expected value is worked out by hand from the text written:
// 1 ft = 0.3048 m, 1° = 10/9 gr, 1 mil = 1/16 gr, 123.758333° = 137.509259 gr.
#include "FieldBookTestSupport.h"
#include "core/TextEncoding.h"
#include "fieldbook/LectSokkia.h"
#include "fieldbook/ParamDriver.h"

#include <gtest/gtest.h>

using namespace pyr;

namespace {

constexpr double U = kUndefined;

struct SokkiaRun : ReaderRun<CLectSokkia> {
    CParamDriver driver{"", "", FieldBookFormat::Sokkia};

    SokkiaRun() { reader.SetDriver(&driver); }
    SokkiaRun& Set(const char* key, std::string value) {
        driver.SetText(key, std::move(value));
        return *this;
    }
    std::string Lines() const {
        std::string lines;
        for (const std::string& line : Reports())
            lines += line + "\n";
        return lines;
    }
};

// SDR33 fields: identifiers right-justified, reals and texts left-justified, 16 characters each.
std::string Id(std::string_view id) {
    return std::string(16 - id.size(), ' ') + std::string(id);
}
std::string Re(std::string_view value) {
    return std::string(value) + std::string(16 - value.size(), ' ');
}
std::string Header(char angles, char distances, char order) {
    return std::string("00NMSDR33 V04-04.02     22-Nov-26 10:15 ") + angles + distances + "11" + order +
           "1\n";
}
std::string Station(std::string_view name, std::string_view north, std::string_view east,
                    std::string_view hi = "1.550", std::string_view z = "100.000") {
    return "02TP" + Id(name) + Re(north) + Re(east) + Re(z) + Re(hi) + Re("") + "\n";
}
std::string Observation(std::string_view to, std::string_view sd, std::string_view v, std::string_view hz,
                        std::string_view code = "", std::string_view derivation = "F1",
                        std::string_view from = "S1") {
    return "09" + std::string(derivation) + Id(from) + Id(to) + Re(sd) + Re(v) + Re(hz) + Re(code) + "\n";
}
std::string Backsight(std::string_view to, std::string_view azimuth, std::string_view hz,
                      std::string_view from = "S1") {
    return "07TP" + Id(from) + Id(to) + Re(azimuth) + Re(hz) + "\n";
}

// One expected element: its kind, its name (or the text of a comment, the word of a command), and for
// a sighting HP, AH, AV, DI, for a point X, Y, Z, for a station HI; U where nothing must be.
struct Element {
    int kind;
    std::string name;
    std::vector<double> values = {};
};

std::string NameOf(const CCarnet& carnet, int i) {
    const int kind = carnet.GetType(i);
    if (kind == kKindComment) return carnet.As<CComment>(i)->text();
    if (IsCommandKind(kind)) return carnet.cmdAt(i);
    return carnet.matAt(i);
}

void ExpectElements(const CCarnet& carnet, const std::vector<Element>& expected) {
    ASSERT_EQ(carnet.GetSize(), static_cast<int>(expected.size()));
    for (int i = 0; i < carnet.GetSize(); ++i) {
        const Element& e = expected[static_cast<std::size_t>(i)];
        EXPECT_EQ(carnet.GetType(i), e.kind) << "element " << i;
        EXPECT_EQ(NameOf(carnet, i), e.name) << "element " << i;
        std::vector<double> actual;
        if (e.kind == kKindPoint) actual = {carnet.xAt(i), carnet.yAt(i), carnet.zAt(i)};
        if (e.kind == kKindStation) actual = {carnet.hiAt(i)};
        if (e.kind == kKindReference || e.kind == kKindMesure)
            actual = {carnet.hpAt(i), carnet.ahAt(i), carnet.avAt(i), carnet.diAt(i)};
        for (std::size_t k = 0; k < e.values.size() && k < actual.size(); ++k) {
            if (IsUndefined(e.values[k]))
                EXPECT_EQ(actual[k], kUndefined) << "value " << k << " of element " << i;
            else // 0.1 mm, 0.1 mgon
                EXPECT_NEAR(actual[k], e.values[k], 1e-4) << "value " << k << " of element " << i;
        }
    }
}

std::string Comment(const char* label, const char* value) {
    return PadRight(label, kHeaderLabelWidth) + " = " + value;
}

TEST(LectSokkia, Sdr33BookInGradsNorthFirstFramedWithItsChecksum) {
    SokkiaRun run;
    const CCarnet& carnet = run.Read(ReadBytes(FieldBookData("sokkia-sdr33.sdr")));
    EXPECT_EQ(run.Lines(), "");
    ExpectElements(carnet, {
                               {1000, Comment("Version", "SDR33 V04-04.02")},
                               {1000, Comment("Format", "SDR33")},
                               {1000, Comment("Date", "22-Nov-26 10:15")},
                               {1000, "Unité des angles     = grades"},
                               {1000, "Unité des distances  = mètres"},
                               {1000, "Ordre des coordonnées = N-E-Z"},
                               {1000, Comment("Chantier", "CHANTIER A")},
                               {1000, Comment("Appareil", "SET5F V01-00")},
                               {1000, Comment("Numéro de série", "123456")},
                               {1000, Comment("Angle vertical", "zénithal")},
                               {1000, Comment("Constante de prisme", "-30.0000")},
                               {1009, "BORNE"},
                               {1006, "S1", {1000.0, 2000.0, 100.0}},
                               {1001, "S1", {1.55}},
                               {1000, Comment("Gisement de référence", "S1 -> A1 : 100.00000 gr")},
                               // the backsight sighted in both faces: two references
                               {1002, "A1", {1.3, 50.0, 100.0, 100.0}},
                               {1002, "A1", {1.3, 250.0, 300.0, 100.0}},
                               {1009, "ARB"},
                               {1003, "104", {1.3, 350.0, 99.9, 10.0}},
                               // the 08 of 104 that follows its observation is computed: not kept
                               {1003, "105", {1.3, 375.1234, U, U}},
                               {1006, "A1", {1100.0, 2000.0, U}},
                               {1000, "Brouillard léger"},
                           });
}

TEST(LectSokkia, Sdr2xBookInDegreesAndFeetEastFirstWithTouchingReals) {
    SokkiaRun run;
    const CCarnet& carnet = run.Read(ReadBytes(FieldBookData("sokkia-sdr2x.sdr")));
    EXPECT_EQ(run.Lines(), "");
    const double foot = 0.3048, hp = 4.5 * foot;
    ExpectElements(carnet, {
                               {1000, Comment("Version", "SDR20 V03-05")},
                               {1000, Comment("Format", "SDR2x")},
                               {1000, Comment("Date", "01-Jan-99 08:30")},
                               {1000, "Unité des angles     = degrés décimaux"},
                               {1000, "Unité des distances  = pieds"},
                               {1000, "Ordre des coordonnées = E-N-Z"},
                               {1006, "1", {1000 * foot, 2000 * foot, 100 * foot}},
                               {1001, "1", {5 * foot}},
                               {1000, Comment("Gisement de référence", "1 -> 2 : 100.00000 gr")},
                               {1002, "2", {hp, 50.0, 100.0, 100 * foot}},
                               {1009, "MUR"},
                               {1003, "3", {hp, 137.509259, 99.444444, 50 * foot}},
                               // MC: azimuth 180° = 200 gr, circle = 200 - (100 - 50) = 150 gr
                               {1003, "4", {hp, 150.0, 300.0, 20 * foot}},
                               {1009, "PIQUET"},
                               {1006, "5", {1100 * foot, 2100 * foot, 110 * foot}},
                           });
}

// The header's units and axis order win over the settings, which hold when the book says nothing.
TEST(LectSokkia, UnitsAndAxisOrderFromTheHeaderOrTheSettings) {
    struct Case {
        const char* header; // angle, distance and order digits; "" for no header
        const char* angleSetting;
        const char* hz;
        double x, y, ah, di;
    };
    const Case cases[] = {
        {"211", "grades", "90", 1000, 2000, 90, 10},      {"111", "grades", "90", 1000, 2000, 100, 10},
        {"311", "grades", "1600", 1000, 2000, 100, 10},   {"411", "grades", "3200", 1000, 2000, 200, 10},
        {"221", "grades", "90", 304.8, 609.6, 90, 3.048}, {"212", "grades", "90", 2000, 1000, 90, 10},
        {"211", "degres", "90", 1000, 2000, 90, 10},      {"", "degres", "90", 1000, 2000, 100, 10},
    };
    for (const Case& c : cases) {
        SokkiaRun run;
        run.Set(kKeyUniteAngles, c.angleSetting);
        std::string text = *c.header ? Header(c.header[0], c.header[1], c.header[2]) : "";
        text += Station("S1", "2000", "1000") + Observation("P", "10", "100", c.hz);
        const CCarnet& carnet = run.Read(text);
        SCOPED_TRACE(std::string("header ") + c.header + ", " + c.angleSetting);
        const int point = carnet.Find(kKindPoint, "S1", 0, 0);
        const int sighting = carnet.Find(kKindMesure, "P", 0, 0);
        ASSERT_GE(point, 0);
        ASSERT_GE(sighting, 0);
        EXPECT_NEAR(carnet.xAt(point), c.x, 1e-4);
        EXPECT_NEAR(carnet.yAt(point), c.y, 1e-4);
        EXPECT_NEAR(carnet.ahAt(sighting), c.ah, 1e-4);
        EXPECT_NEAR(carnet.diAt(sighting), c.di, 1e-4);
        EXPECT_EQ(run.Lines(), "");
    }
    SokkiaRun run;
    run.Set(kKeyOrdreCoordonnees, "XY");
    const CCarnet& carnet = run.Read("08KI" + Id("P") + Re("2000") + Re("1000") + Re("") + "\n");
    EXPECT_NEAR(carnet.xAt(carnet.Find(kKindPoint, "P", 0, 0)), 2000.0, 1e-4);

    // Columns count characters: a Latin-1 identifier, two bytes a letter once read, moves no field.
    SokkiaRun latin1;
    const CCarnet& read = latin1.Read("08KI" + Id("\xC9T\xC9") + Re("2000") + Re("1000") + Re("") + "\n");
    const int ete = read.Find(kKindPoint, "ÉTÉ", 0, 0);
    ASSERT_GE(ete, 0);
    EXPECT_NEAR(read.xAt(ete), 1000.0, 1e-4);
    EXPECT_NEAR(read.yAt(ete), 2000.0, 1e-4);
}

TEST(LectSokkia, VerticalAnglesFromTheHorizonBecomeZenithAngles) {
    SokkiaRun run;
    const std::string instrument = "01NM:" + std::string(16, ' ') + "123456" + std::string(22, ' ') + "32\n";
    const CCarnet& carnet = run.Read(instrument + Station("S1", "", "") + Observation("P", "10", "10", "0") +
                                     Observation("Q", "10", "-5", "0"));
    EXPECT_NEAR(carnet.avAt(carnet.Find(kKindMesure, "P", 0, 0)), 90.0, 1e-4);
    EXPECT_NEAR(carnet.avAt(carnet.Find(kKindMesure, "Q", 0, 0)), 105.0, 1e-4);
}

// The backsight is always a reference; the settings may mark others, the first sighting or codes.
TEST(LectSokkia, ReferenceSightings) {
    const std::string book = Station("S1", "2000", "1000") + Backsight("A1", "100", "50") +
                             Observation("B", "10", "100", "10") + Observation("A1", "100", "100", "50") +
                             Observation("C", "10", "100", "20", "REF");
    struct Case {
        const char* marking;
        std::vector<int> kinds; // B, A1, C
    };
    const Case cases[] = {
        {"aucune", {1003, 1002, 1003}}, {"premiere", {1002, 1002, 1003}}, {"codes", {1003, 1002, 1002}}};
    for (const Case& c : cases) {
        SokkiaRun run;
        run.Set(kKeyReferences, c.marking).Set(kKeyCodesReference, "ref,X");
        const CCarnet& carnet = run.Read(book);
        SCOPED_TRACE(c.marking);
        std::vector<int> kinds;
        for (const char* point : {"B", "A1", "C"})
            for (int i = 0; i < carnet.GetSize(); ++i)
                if (carnet.matAt(i) == point && carnet.GetType(i) != kKindCommand)
                    kinds.push_back(carnet.GetType(i));
        EXPECT_EQ(kinds, c.kinds);
    }
    // A backsight that no observation sights leaves its circle reading as the station's reference.
    SokkiaRun run;
    const CCarnet& carnet =
        run.Read(Station("S1", "", "", "1.550", "") + Backsight("A1", "", "12.3456") +
                 Observation("B", "10", "100", "10") + Station("S2", "", "", "1.550", "100"));
    ExpectElements(carnet, {{1000, Comment("Format", "SDR33")},
                            {1001, "S1", {1.55}},
                            {1003, "B", {U, 10.0, 100.0, 10.0}},
                            {1002, "A1", {U, 12.3456, U, U}},
                            {1006, "S2", {U, U, 100.0}},
                            {1001, "S2", {1.55}}});
}

// Blanks are values the instrument did not record: they stay missing, never 0.
TEST(LectSokkia, MissingValuesStayMissingAndComputedPointsFollowTheSetting) {
    const std::string book = Station("S1", "", "", "", "") + Observation("P", "", "99.5", "10") + "08TP" +
                             Id("P") + Re("2010") + Re("1000") + Re("") + "\n";
    for (const char* keep : {"0", "1"}) {
        SokkiaRun run;
        run.Set(kKeyPointsCalcules, keep);
        const CCarnet& carnet = run.Read(book);
        std::vector<Element> expected{
            {1000, Comment("Format", "SDR33")}, {1001, "S1", {U}}, {1003, "P", {U, 10.0, 99.5, U}}};
        if (*keep == '1') expected.push_back({1006, "P", {1000.0, 2010.0, U}});
        SCOPED_TRACE(keep);
        ExpectElements(carnet, expected);
        EXPECT_EQ(run.Lines(), "");
    }
}

// Each line that cannot be used is reported with its number, and the reading goes on.
TEST(LectSokkia, LinesReportedWithTheirNumbers) {
    struct Case {
        std::string book;
        std::string reports;
    };
    const Case cases[] = {
        {"11NM whatever\nXYZ\n",
         "Erreur ligne 1 : donnée non reconnue !\nErreur ligne 2 : donnée non reconnue !\n"},
        {Station("S1", "20O0", "1000"), "Erreur ligne 1 : valeur numérique incorrecte <20O0> !\n"},
        {Station("", "2000", "1000"), "Erreur ligne 1 : donnée manquante pour le nom de la station !\n"},
        {Station("S1", "2000", ""), "Erreur ligne 1 : donnée manquante pour la coordonnée Est !\n"},
        {"03NM" + Re("") + "\n", "Erreur ligne 1 : donnée manquante pour la hauteur de prisme !\n"},
        {"03NM" + Re("1.5") + "1234567890\n", "Attention : ligne 1 de longueur incorrecte (30 / 20) !\n"},
        {Observation("P", "10", "100", "0", "", "F1", ""),
         "Erreur ligne 1 : pas de station pour cette visée !\n"},
        {Observation("P", "", "", ""), "Erreur ligne 1 : donnée manquante pour les observations !\n"},
        {Observation("P", "10", "100", "0", "", "F1", "S9"),
         "Attention : ligne 1 : visées depuis <S9> sans enregistrement de station, station ouverte sans "
         "hauteur "
         "d'instrument.\n"},
        {Station("S1", "", "") + Observation("P", "10", "100", "0", "", "MC"),
         "Attention : ligne 2 : visée MC sans référence orientée à la station <S1>, son gisement est gardé "
         "comme lecture horizontale.\n"},
        {"00NMSDR33 V04-04.02     22-Nov-26 10:15 711111\n",
         "Attention : ligne 1 : code « 7 » inconnu pour l'unité des angles, valeur du fichier de paramétrage "
         "prise.\n"},
        // "03NM1.5": 48+51+78+77+49+46+53 = 402
        {"\x02\n03NM1.5\n\x03"
         "00402\n",
         ""},
        {"\x02\n03NM1.5\n\x03"
         "00000\n",
         ""},
        {"\x02\n03NM1.5\n\x03"
         "00403\n",
         "Attention : ligne 3 : la somme de contrôle 00403 ne correspond pas aux données reçues ; vérifiez "
         "le "
         "transfert du carnet.\n"},
    };
    for (const Case& c : cases) {
        SokkiaRun run;
        run.Read(c.book);
        EXPECT_EQ(run.Lines(), c.reports) << c.book;
    }
}

// CRLF, LF, CR alone, trailing blanks cut, transfer controls: the same elements.
TEST(LectSokkia, LineEndsAndTransferBytesGiveTheSameElements) {
    const std::string book = ReadBytes(FieldBookData("sokkia-sdr33.sdr"));
    SokkiaRun reference;
    const CCarnet& expected = reference.Read(book);
    std::string lf, cr, cut;
    for (std::size_t i = 0; i < book.size(); ++i) {
        if (book[i] == '\r') continue;
        lf += book[i];
        cr += book[i] == '\n' ? '\r' : book[i];
    }
    for (std::size_t start = 0; start < lf.size();) {
        const std::size_t end = lf.find('\n', start);
        const std::string line = lf.substr(start, end - start);
        cut += line.substr(0, line.find_last_not_of(' ') + 1) + '\n';
        start = end + 1;
    }
    for (const std::string& variant : {lf, cr, cut + "\x04\n\x1a"}) {
        SokkiaRun run;
        const CCarnet& carnet = run.Read(variant);
        ASSERT_EQ(carnet.GetSize(), expected.GetSize());
        for (int i = 0; i < carnet.GetSize(); ++i)
            EXPECT_EQ(NameOf(carnet, i), NameOf(expected, i));
    }
}

} // namespace
