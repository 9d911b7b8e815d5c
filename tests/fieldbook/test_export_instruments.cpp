// Points exported to the coordinate files of total stations (GSI, GDM area, SDR) and read back by our
// readers of those formats. The surveys are constructed: Lambert-93 coordinates to the 0.1 mm, negative
// ones, a point without altitude, an altimetric benchmark without planimetry. Expected records are written
// by hand from the record layouts (each word or field counted out), not copied from our output; three of
// them are point records of real instrument files, rewritten here with the same values.
#include "FieldBookTestSupport.h"
#include "fieldbook/ExportGdm.h"
#include "fieldbook/ExportLeica.h"
#include "fieldbook/ExportSokkia.h"
#include "fieldbook/LectGeodim.h"
#include "fieldbook/LectSokkia.h"
#include "fieldbook/LectWild.h"
#include "geobase/Matricule.h"

#include <gtest/gtest.h>

using namespace pyr;

namespace {

constexpr double U = kUndefined;

using Pt = SurveyPoint;

// Lambert-93 points to the 0.1 mm; "007" is written with its zeros, which identifiers drop.
const std::vector<Pt> kLambert = {
    {"1", 652345.6789, 6862310.1234, 45.678, "BORNE"},
    {"A12", -1234.5678, -25.0001, -3.25, "MUR"},
    {"007", 651000.1, 6861000.2, U, ""},
    {"N4", U, U, 120.5, "REPERE"},
};
// Small local coordinates with numeric identifiers of four digits at most: what GSI-8 and SDR2x hold.
const std::vector<Pt> kLocal = {
    {"1", 1234.5678, 987.6543, 101.25, "BORNE"},
    {"12", -234.5678, -0.0004, -3.25, ""},
    {"007", 512.3, 498.7, U, "ARBRE"},
    {"9999", U, U, 99.999, ""},
};

// What a reader gave back: each point with the code written in front of it.
std::vector<Pt> PointsOf(const CCarnet& carnet) {
    std::vector<Pt> points;
    std::string code;
    for (int i = 0; i < carnet.GetSize(); ++i) {
        if (carnet.GetType(i) == kKindCommand) code = carnet.cmdAt(i);
        if (carnet.GetType(i) != kKindPoint) continue;
        points.push_back({carnet.matAt(i), carnet.xAt(i), carnet.yAt(i), carnet.zAt(i), code});
        code.clear();
    }
    return points;
}

// The points come back with their identifiers in normal form ("007" is "7"), their codes, and their
// coordinates within `tolerance` (metres, a nanometre more for the double's last bit); a missing
// coordinate stays missing.
void ExpectSamePoints(const std::vector<Pt>& read, const std::vector<Pt>& written, double tolerance,
                      bool codes = true) {
    ASSERT_EQ(read.size(), written.size());
    for (std::size_t i = 0; i < read.size(); ++i) {
        SCOPED_TRACE(written[i].mat);
        EXPECT_EQ(read[i].mat, FormMatView(written[i].mat));
        EXPECT_EQ(read[i].code, codes ? written[i].code : "");
        for (auto [r, w] :
             {std::pair{read[i].x, written[i].x}, {read[i].y, written[i].y}, {read[i].z, written[i].z}}) {
            if (IsUndefined(w))
                EXPECT_EQ(r, kUndefined);
            else
                EXPECT_NEAR(r, w, tolerance + 1e-9);
        }
    }
}

// An export to a temporary folder, its settings file written key by key, its messages recorded.
struct ExportRun {
    TempDir dir;
    ui::ScriptedFrontEnd frontEnd;
    CPyrTxtWnd txt{frontEnd};
    CCarnet carnet;
    PointExportJob job;

    ExportRun(const std::vector<Pt>& points, std::string settings, const char* file = "points.out")
        : carnet(Survey(points)), job(ExportJob(carnet, dir / "export.ini", dir / file, frontEnd, txt)) {
        WriteBytes(job.paramFile, "[Exportation]\n" + settings);
    }
    std::string Written() const { return ReadBytes(job.path); }
    std::string Lines() const {
        std::string lines;
        for (const auto& line : frontEnd.lines)
            lines += line + "\n";
        return lines;
    }
};

template <class Reader, FieldBookFormat kFormat>
std::vector<Pt> ReadBack(std::string_view bytes) {
    DriverRun<Reader, kFormat> run;
    const std::vector<Pt> points = PointsOf(run.Read(bytes));
    EXPECT_EQ(ReportText(run), "");
    return points;
}
const auto ReadGsi = ReadBack<CLectWild, FieldBookFormat::Wild>;
const auto ReadGdm = ReadBack<CLectGeodim, FieldBookFormat::Geotronics>;
const auto ReadSdr = ReadBack<CLectSokkia, FieldBookFormat::Sokkia>;

// ---- GSI -------------------------------------------------------------------------------------------------

// Each variant carries half a unit of its last digit: mm 0.5 mm, 0.1 mm 0.05 mm, 0.01 mm 0.005 mm, feet to
// the thousandth 0.15 mm, to the ten-thousandth 0.015 mm.
TEST(ExportLeica, EveryVariantReadsBackToThePrecisionOfItsUnit) {
    struct Variant {
        const char* settings;
        const std::vector<Pt>& points;
        double tolerance;
    };
    const Variant variants[] = {
        {"FormatGsi=16\nUniteLongueurs=0\n", kLambert, 0.0005},
        {"FormatGsi=16\nUniteLongueurs=6\n", kLambert, 0.00005},
        {"FormatGsi=16\nUniteLongueurs=8\nFinDeLigne=LF\n", kLambert, 0.000005},
        {"FormatGsi=16\nUniteLongueurs=1\n", kLambert, 0.0005 * 0.3048},
        {"FormatGsi=16\nUniteLongueurs=7\n", kLambert, 0.00005 * 0.3048},
        {"FormatGsi=8\nUniteLongueurs=0\n", kLocal, 0.0005},
        {"FormatGsi=8\nUniteLongueurs=6\n", kLocal, 0.00005},
    };
    for (const Variant& v : variants) {
        SCOPED_TRACE(v.settings);
        ExportRun run(v.points, v.settings);
        ASSERT_TRUE(CDlgConfigLeica::Export(run.job));
        ExpectSamePoints(ReadGsi(run.Written()), v.points, v.tolerance);
        EXPECT_EQ(MessageTexts(run.frontEnd), "");
    }
    ExportRun withoutCodes(kLambert, "Code=0\n");
    ASSERT_TRUE(CDlgConfigLeica::Export(withoutCodes.job));
    ExpectSamePoints(ReadGsi(withoutCodes.Written()), kLambert, 0.0005, false);
}

TEST(ExportLeica, BlocksAsTheWordsAreLaidOut) {
    // GSI-16, 0.1 mm: 652345.6789 m is 6523456789 tenths of a millimetre, 16 digits zero-padded; the
    // negative easting keeps its sign; no altitude, no word 83; the benchmark has only its word 83.
    ExportRun run(kLambert, "UniteLongueurs=6\n");
    ASSERT_TRUE(CDlgConfigLeica::Export(run.job));
    EXPECT_EQ(run.Written(), "*110001+0000000000000001 81..06+0000006523456789 82..06+0000068623101234 "
                             "83..06+0000000000456780 71....+00000000000BORNE \r\n"
                             "*110002+0000000000000A12 81..06-0000000012345678 82..06-0000000000250001 "
                             "83..06-0000000000032500 71....+0000000000000MUR \r\n"
                             "*110003+0000000000000007 81..06+0000006510001000 82..06+0000068610002000 \r\n"
                             "*110004+00000000000000N4 83..06+0000000001205000 71....+0000000000REPERE \r\n");

    // Words 11, 81, 82, 83 and 71 of an instrument's GSI-8 block (its first line, the observation
    // words between them left aside), and word 11 of the second block of a GSI-16 one.
    ExportRun gsi8({{"1", 515.836, 525.871, 3.079, "1"}}, "FormatGsi=8\n");
    ASSERT_TRUE(CDlgConfigLeica::Export(gsi8.job));
    EXPECT_EQ(gsi8.Written(),
              "110001+00000001 81..00+00515836 82..00+00525871 83..00+00003079 71....+00000001 \r\n");
    ExportRun gsi16({{"GDEM5414", 1, 2, U, ""}, {"GDEM5415", 1, 2, U, ""}}, "FinDeLigne=LF\n");
    ASSERT_TRUE(CDlgConfigLeica::Export(gsi16.job));
    EXPECT_NE(gsi16.Written().find("\n*110002+00000000GDEM5415 81..00+"), std::string::npos);
}

TEST(ExportLeica, WhatTheWordsCannotHoldIsLeftOutAndSaid) {
    std::vector<Pt> points = kLambert;
    points.push_back({"ABCDEFGHIJKLMNOPQ", 1, 2, 3, ""});
    points.push_back({"C1", 1, 2, 3, "CODE_DE_17_CARACT"});
    ExportRun gsi16(points, "");
    ASSERT_TRUE(CDlgConfigLeica::Export(gsi16.job));
    EXPECT_EQ(gsi16.Lines(), "Point <ABCDEFGHIJKLMNOPQ> non exporté : matricule de plus de 16 caractères.\n"
                             "Point <C1> non exporté : code de plus de 16 caractères.\n");
    EXPECT_EQ(ReadGsi(gsi16.Written()).size(), kLambert.size());

    // GSI-8 in mm holds 99 999.999 m: a Lambert-93 point is left out, not cut; one in 0.01 mm holds
    // 999.99999.
    ExportRun gsi8({{"1", 652345.678, 6862310.123, 45.0, ""},
                    {"2", 99999.999, -99999.999, 1.0, ""},
                    {"123456789", 1, 2, 3, ""}},
                   "FormatGsi=8\n");
    ASSERT_TRUE(CDlgConfigLeica::Export(gsi8.job));
    EXPECT_EQ(gsi8.Lines(), "Point <1> non exporté : X trop grand pour le format (GSI-8 en mm).\n"
                            "Point <123456789> non exporté : matricule de plus de 8 caractères.\n");
    EXPECT_EQ(MessageTexts(gsi8.frontEnd), "2 point(s) non exporté(s) : le format du fichier ne peut pas "
                                           "les écrire.\nVoir la fenêtre de texte.");
    EXPECT_EQ(gsi8.Written(), "110001+00000002 81..00+99999999 82..00-99999999 83..00+00001000 \r\n");
    ExportRun hundredths({{"1", 0.5, 1000.0, U, ""}}, "FormatGsi=8\nUniteLongueurs=8\n");
    ASSERT_TRUE(CDlgConfigLeica::Export(hundredths.job));
    EXPECT_EQ(hundredths.Lines(),
              "Point <1> non exporté : Y trop grand pour le format (GSI-8 en 0,01 mm).\n");
}

// ---- GDM -------------------------------------------------------------------------------------------------

TEST(ExportGdm, AreaFileReadsBackInMetresAndInFeet) {
    for (const char* settings : {"Decimales=4\n", "Decimales=5\nUniteDistances=pieds\n"}) {
        SCOPED_TRACE(settings);
        ExportRun run(kLambert, settings);
        ASSERT_TRUE(dll_ExportSpectra(run.job));
        // 0.1 mm in metres, 0.01 mm of a foot (0.003 mm).
        ExpectSamePoints(ReadGdm(run.Written()), kLambert, 0.00005);
    }
    ExportRun run(kLambert, "");
    ASSERT_TRUE(dll_ExportSpectra(run.job));
    EXPECT_EQ(run.Written(), "23=1111\r\n"
                             "5=1\r\n4=BORNE\r\n38=652345.679\r\n37=6862310.123\r\n39=45.678\r\n"
                             "5=A12\r\n4=MUR\r\n38=-1234.568\r\n37=-25.000\r\n39=-3.250\r\n"
                             "5=007\r\n38=651000.100\r\n37=6861000.200\r\n"
                             "5=N4\r\n4=REPERE\r\n39=120.500\r\n");
}

TEST(ExportGdm, BlocksOfAnInstrumentsAreaFile) {
    // The first two blocks of an instrument's area file, negative eastings to the centimetre, LF.
    ExportRun run({{"GP1", -23779.46, 12273.89, U, ""}, {"GP3", -23512.63, 12056.64, U, ""}},
                  "Decimales=2\nLabelUnites=0\nFinDeLigne=LF\n");
    ASSERT_TRUE(dll_ExportSpectra(run.job));
    EXPECT_EQ(run.Written(), "5=GP1\n38=-23779.46\n37=12273.89\n5=GP3\n38=-23512.63\n37=12056.64\n");
}

// ---- SDR -------------------------------------------------------------------------------------------------

TEST(ExportSokkia, EveryVariantReadsBackWithTheUnitsAndOrderOfItsHeader) {
    struct Variant {
        const char* settings;
        const std::vector<Pt>& points;
        double tolerance;
    };
    const Variant variants[] = {
        {"", kLambert, 0.00005},
        {"OrdreCoordonnees=XY\nUniteDistances=pieds\nDecimales=5\n", kLambert, 0.000005 * 0.3048},
        {"Encadrement=1\nDecimales=8\n", kLambert, 0.000000005},
        {"Encadrement=1\nFinDeLigne=LF\n", kLambert, 0.00005},
        {"Format=SDR2x\n", kLocal, 0.00005},
        {"Format=SDR2x\nOrdreCoordonnees=XY\nEncadrement=1\n", kLocal, 0.00005},
    };
    for (const Variant& v : variants) {
        SCOPED_TRACE(v.settings);
        ExportRun run(v.points, v.settings);
        ASSERT_TRUE(DlgCfgSok::Export(run.job));
        // The reader reports a checksum that does not match and records longer than their layout.
        ExpectSamePoints(ReadSdr(run.Written()), v.points, v.tolerance);
        EXPECT_EQ(MessageTexts(run.frontEnd), "");
    }
}

TEST(ExportSokkia, RecordsAsTheFieldsAreLaidOut) {
    // SDR2x: identifier on 4 columns zero-filled, reals on 10 left-justified, description on 16.
    ExportRun sdr2x({{"12", -234.5678, 1000, U, "MUR"}}, "Format=SDR2x\nFinDeLigne=LF\n");
    ASSERT_TRUE(DlgCfgSok::Export(sdr2x.job));
    EXPECT_EQ(sdr2x.Written(), "00NMSDR20" + std::string(11 + 4, ' ') + "00-000-00 00:00 211111\n" +
                                   "08KI0012" + "1000.0000 " + "-234.5678 " + "          " +
                                   "MUR             \n");

    // The header and a point record of an instrument's SDR33 transfer, N-E-Z, with its values: only the
    // derivation differs, KI (keyed in) where the collector wrote TP (measured). Framed, the checksum is
    // the sum of the bytes of both records and their LF, modulo 65536.
    ExportRun sdr33({{"00000009", 908.838, 510.504, 19.699, "11"}}, "Decimales=8\nFinDeLigne=LF\n");
    ASSERT_TRUE(DlgCfgSok::Export(sdr33.job));
    const std::string header = "00NMSDR33 V04-04.02     00-000-00 00:00 211111\n";
    const std::string record =
        "08KI        00000009510.50400000    908.83800000    19.69900000     11              \n";
    EXPECT_EQ(sdr33.Written(), header + record);

    ExportRun framed({{"00000009", 908.838, 510.504, 19.699, "11"}},
                     "Decimales=8\nFinDeLigne=LF\nEncadrement=1\n");
    ASSERT_TRUE(DlgCfgSok::Export(framed.job));
    unsigned sum = 0;
    for (char c : header + record)
        sum += static_cast<unsigned char>(c);
    EXPECT_EQ(framed.Written(), "\x02\n" + header + record + "\x03" + Sprintf("%05u", sum % 65536) + "\n");
}

TEST(ExportSokkia, WhatTheFieldsCannotHoldIsLeftOutAndSaid) {
    ExportRun sdr33({{"ABCDEFGHIJKLMNO", 1, 2, 3, ""},
                     {"ABCDEFGHIJKLMN", 1, 2, 3, ""},
                     {"C", 1, 2, 3, "CODE_DE_17_CARACT"}},
                    "FinDeLigne=LF\n");
    ASSERT_TRUE(DlgCfgSok::Export(sdr33.job));
    EXPECT_EQ(sdr33.Lines(), "Point <ABCDEFGHIJKLMNO> non exporté : matricule de plus de 14 caractères.\n"
                             "Point <C> non exporté : code de plus de 16 caractères.\n");
    EXPECT_EQ(ReadSdr(sdr33.Written()).size(), 1u);

    // SDR2x: numbers of four digits, reals of ten characters; a Lambert-93 northing holds to the centimetre.
    ExportRun sdr2x({{"12345", 1, 2, 3, ""},
                     {"A1", 1, 2, 3, ""},
                     {"2", 652345.67, 6862310.12, U, ""},
                     {"3", 652345.67, 6862310.123, U, ""}},
                    "Format=SDR2x\nDecimales=2\n");
    ASSERT_TRUE(DlgCfgSok::Export(sdr2x.job));
    EXPECT_EQ(sdr2x.Lines(),
              "Point <12345> non exporté : matricule de plus de 4 caractères.\n"
              "Point <A1> non exporté : matricule non numérique (le SDR2x ne connaît que des numéros).\n");
    ExportRun mm({{"3", 652345.67, 6862310.123, U, ""}}, "Format=SDR2x\nDecimales=3\n");
    ASSERT_TRUE(DlgCfgSok::Export(mm.job));
    EXPECT_EQ(
        mm.Lines(),
        "Point <3> non exporté : Y trop grand pour le format (SDR2x : 10 caractères avec 3 décimales).\n");
    ExpectSamePoints(ReadSdr(sdr2x.Written()),
                     {{"2", 652345.67, 6862310.12, U, ""}, {"3", 652345.67, 6862310.12, U, ""}}, 0.005);
}

// ---- All three -------------------------------------------------------------------------------------------

using Writer = bool (*)(const PointExportJob&);
struct Format {
    const char* name;
    Writer write;
    std::vector<Pt> (*read)(std::string_view);
};
const Format kFormats[] = {{"GSI", CDlgConfigLeica::Export, ReadGsi},
                           {"GDM", dll_ExportSpectra, ReadGdm},
                           {"SDR", DlgCfgSok::Export, ReadSdr}};

TEST(ExportInstruments, CompletingAFileKeepsItsPointsAndWritesNoSecondHeader) {
    const std::vector<Pt> first(kLambert.begin(), kLambert.begin() + 2);
    const std::vector<Pt> second(kLambert.begin() + 2, kLambert.end());
    for (const Format& format : kFormats) {
        SCOPED_TRACE(format.name);
        ExportRun run(first, "Encadrement=1\n");
        ASSERT_TRUE(format.write(run.job));
        CCarnet more = Survey(second);
        run.job.carnet = &more;
        run.job.append = true;
        ASSERT_TRUE(format.write(run.job));
        ExpectSamePoints(format.read(run.Written()), kLambert, 0.0005);
        const std::string text = run.Written();
        EXPECT_EQ(text.find("00NM"), text.rfind("00NM"));
    }
    // Completing a file that does not exist yet makes a whole one, header included.
    ExportRun run(kLambert, "");
    run.job.append = true;
    ASSERT_TRUE(DlgCfgSok::Export(run.job));
    EXPECT_EQ(run.Written().substr(0, 4), "00NM");
}

TEST(ExportInstruments, NothingIsWrittenWithoutUsableSettingsOrFolder) {
    for (const Format& format : kFormats) {
        SCOPED_TRACE(format.name);
        ExportRun missing(kLambert, "");
        std::filesystem::remove(missing.job.paramFile);
        EXPECT_FALSE(format.write(missing.job));
        EXPECT_EQ(MessageTexts(missing.frontEnd),
                  "Le fichier de paramètres d'export <" + missing.job.paramFile + "> n'existe pas !");
        EXPECT_FALSE(std::filesystem::exists(missing.job.path));

        ExportRun bad(kLambert, "FormatGsi=12\nDecimales=9\nFormat=SDR34\n");
        EXPECT_FALSE(format.write(bad.job));
        EXPECT_NE(MessageTexts(bad.frontEnd)
                      .find("Fichier de paramètres d'export <" + bad.job.paramFile + "> :\nvaleur « "),
                  std::string::npos);
        EXPECT_FALSE(std::filesystem::exists(bad.job.path));

        ExportRun nowhere(kLambert, "", "dossier-absent/points.out");
        EXPECT_FALSE(format.write(nowhere.job));
        EXPECT_EQ(MessageTexts(nowhere.frontEnd)
                      .rfind("Impossible d'écrire le fichier\n<" + nowhere.job.path + ">", 0),
                  0u);
    }
    ExportRun bad(kLambert, "UniteLongueurs=3\n");
    EXPECT_FALSE(CDlgConfigLeica::Export(bad.job));
    EXPECT_EQ(MessageTexts(bad.frontEnd),
              "Fichier de paramètres d'export <" + bad.job.paramFile +
                  "> :\nvaleur « 3 » incorrecte pour UniteLongueurs (valeurs possibles : "
                  "0 mm, 6 0,1 mm, 8 0,01 mm, 1 pied, 7 pied au dix-millième) !");
}

TEST(ExportInstruments, AnEmptyScopeWritesAFileWithoutPoints) {
    const std::vector<int> noneSelected;
    for (const Format& format : kFormats) {
        SCOPED_TRACE(format.name);
        ExportRun run(kLambert, "LabelUnites=0\n");
        run.job.selection = &noneSelected;
        ASSERT_TRUE(format.write(run.job));
        EXPECT_TRUE(format.read(run.Written()).empty());
        EXPECT_EQ(run.Written().empty(), format.write != DlgCfgSok::Export);
    }
}

} // namespace
