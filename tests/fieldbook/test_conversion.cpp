// A whole conversion: settings read, dialog, settings written back, reading, then a new GéoBase or the
// elements appended to the editor's; and every way it stops without touching anything.
#include "FieldBookTestSupport.h"
#include "core/Lines.h"
#include "fieldbook/FieldBookConverter.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/LectCarnet.h"
#include "fieldbook/QuendalPivot.h"
#include "fieldbook/QuendalReader.h"
#include "fieldbook/TableCode.h"
#include "settings/CalcOptions.h"
#include "settings/LastGeoBase.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <sys/stat.h>

using namespace pyr;
using ui::Answer;
using ui::DialogResult;
namespace fs = std::filesystem;

namespace {

constexpr const char* kBook = "QUENDAL-PC;1\n"
                              "STATION;S1;1.562\n"
                              "REFERENCE;A1;1.3;323.76206;99.40145;260.0083\n"
                              "MESURE;102;1.8;388.64623;99.18242;111.5994;POTEAU\n";
constexpr const char* kEmptyGeoBase = "GEOBASE PYRALIS\t1\n";
constexpr const char* kJob = "GEOBASE PYRALIS\t1\n"
                             "1006\tA1\t651050.118\t6862512.447\t-999999\tXY\tBORNE\n";

class Conversion : public ::testing::Test {
protected:
    Conversion() {
        fs::create_directories(install + "Config");
        for (const char* file : {"Wild.ini", "Defaut.cod"})
            fs::copy_file(std::string(PYR_SOURCE_DIR) + "/data/Config/" + file, install + "Config/" + file);
        WriteBytes(dir / "carnet.qdl", kBook);
    }
    std::unique_ptr<FieldBookConverter> Make(FieldBookFormat format, EditorDocument* document = nullptr) {
        return std::make_unique<FieldBookConverter>(format, &frontEnd, Params(), install, &txt, document);
    }
    // A conversion of the Quendal-Pc field book, with that command line.
    DialogResult Convert(std::vector<std::string> arguments, CCarnet* target = nullptr,
                         FieldBookFormat format = FieldBookFormat::Quendal) {
        frontEnd.dialogArguments = std::move(arguments);
        auto converter = Make(format);
        if (format != FieldBookFormat::Quendal)
            converter->makeReader = [] { return std::make_unique<CQuendalReader>(); };
        return RunConversion(*converter, target);
    }
    std::string Params() const { return dir / "Pyralis.ini"; }
    std::string Key(const char* section, const char* key) const {
        std::string value;
        ReadParamString(Params(), section, key, "", value);
        return value;
    }
    std::string LastFile() const {
        std::string value;
        ReadParamString(kRegistrySettings, kSectionPyralis, kKeyDernierFichier, "", value);
        return value;
    }
    bool Said(const std::string& line) const {
        return std::find(frontEnd.lines.begin(), frontEnd.lines.end(), line) != frontEnd.lines.end();
    }

    TempDir dir;
    ScopedEnv registry{"PYRALIS_REGISTRE", dir / "registre"};
    std::string install = dir / "installation/";
    ui::ScriptedFrontEnd frontEnd;
    CPyrTxtWnd txt{frontEnd};
};

} // namespace

// What is written and said is run end to end by the host's tests; here, what the settings keep.
TEST_F(Conversion, ANewGeoBaseIsWrittenBesideTheFieldBookAndRecorded) {
    EXPECT_EQ(Convert({dir / "carnet.qdl"}), DialogResult::Ok);
    EXPECT_EQ(frontEnd.dialogs, std::vector<std::string>{"Lecture du carnet Quendal-Pc"});
    EXPECT_TRUE(Said("GéoBase créée = <" + dir / "carnet.geo" + ">."));
    EXPECT_EQ(Key("Carnet.Quendal", "Carnet"), dir / "carnet.qdl");
    EXPECT_EQ(Key("Carnet.Quendal", "Interprétation") + Key("Carnet.Quendal", "EcrireAppareil"), "00");
    EXPECT_EQ(ReadLastGeoBase(Params()), dir / "carnet.geo");
    EXPECT_EQ(LastFile(), dir / "carnet.geo");
}

// A field book that gives no element (empty, junk, another format, or only a header that the format
// skips) is a failure that says which book and format: the existing GéoBase stays as it was, the editor's
// gets nothing, the last file stays the one the surveyor worked on; a new, empty GéoBase is left only where
// there was no file. The instrument the conversion writes at the head is no element read.
TEST_F(Conversion, AFieldBookWithNothingToReadIsAFailureThatReplacesNothing) {
    const struct {
        const char* what;
        std::string book;
        bool geoBaseThere;
        bool merge;
        bool instrument;
    } cases[] = {
        {"vide, GéoBase absente", "", false, false, false},
        {"en-tête seul, GéoBase absente", "QUENDAL-PC;1\n\n", false, false, true},
        {"octets quelconques, GéoBase présente", "\x7f\x45LF\x02\x01\xff\xfe\n\x00\x01", true, false, false},
        {"autre format, GéoBase présente", "0000000001+0000000000000101 21.324+0000000012345678\n", true,
         false, true},
        {"vide, dans la GéoBase de l'éditeur", "", false, true, true},
    };
    for (const auto& c : cases) {
        fs::remove(dir / "vide.geo");
        if (c.geoBaseThere) WriteBytes(dir / "vide.geo", kJob);
        WriteLastGeoBase(Params(), "avant.geo");
        WriteParamString(kRegistrySettings, kSectionPyralis, kKeyDernierFichier, "avant.geo");
        WriteBytes(dir / "vide.qdl", c.book);
        frontEnd = {};
        CCarnet target;
        target.Add(std::make_unique<CComment>("déjà là"), kKindComment);
        const std::vector<std::string> arguments{dir / "vide.qdl", "--ecrire-appareil",
                                                 c.instrument ? "1" : "0"};
        if (c.geoBaseThere) frontEnd.answers = {Answer::Yes}; // replace it: the person agreed
        EXPECT_EQ(Convert(arguments, c.merge ? &target : nullptr), DialogResult::Failed) << c.what;
        EXPECT_TRUE(Said(" ... terminée : " + std::string(c.instrument ? "1" : "0") + " lignes écrites."))
            << c.what << frontEnd.AllLines();
        EXPECT_TRUE(MessageTexts(frontEnd).starts_with("Carnet <" + dir / "vide.qdl" + ">")) << c.what;
        EXPECT_NE(MessageTexts(frontEnd).find("« Quendal-Pc »"), std::string::npos) << c.what;
        EXPECT_EQ(frontEnd.Failures(), 1) << c.what;
        EXPECT_EQ(target.GetSize(), 1) << c.what;
        const std::string left = c.geoBaseThere ? std::string(kJob) : c.merge ? "" : kEmptyGeoBase;
        EXPECT_EQ(fs::exists(dir / "vide.geo") ? ReadBytes(dir / "vide.geo") : "", left) << c.what;
        EXPECT_EQ(ReadLastGeoBase(Params()), "avant.geo") << c.what;
        EXPECT_EQ(LastFile(), "avant.geo") << c.what;
    }
}

// Every format through its own reader and the shipped settings: a field book cut in the middle of its
// last line is told once, with the number of that line in the surveyor's file, and what it held is read.
TEST_F(Conversion, EveryFormatTellsACutLastLineOnce) {
    for (const auto& entry : fs::directory_iterator(std::string(PYR_SOURCE_DIR) + "/data/Config"))
        fs::copy_file(entry.path(), install + "Config/" + entry.path().filename().string(),
                      fs::copy_options::skip_existing);
    const struct {
        FieldBookFormat format;
        const char* sample;
        const char* layout;
    } cases[] = {
        {FieldBookFormat::Geotronics, "gdm-chantier.job", nullptr},
        {FieldBookFormat::NikonAtlas, "nikon-raw-gons.raw", nullptr},
        {FieldBookFormat::NikonPsion, "nikon-dtm.nik", nullptr},
        {FieldBookFormat::Sokkia, "sokkia-sdr33.sdr", nullptr},
        {FieldBookFormat::TopconGT7, "topcon-metres-dms.gts7", nullptr},
        {FieldBookFormat::Wild, "wild-gsi8-41.gsi", nullptr},
        {FieldBookFormat::Zeiss, "zeiss-m5-mesures.txt", nullptr},
        {FieldBookFormat::Separateur, "leve-separateur.csv", "leve.sep"},
        {FieldBookFormat::Colonne, "leve-colonne.txt", "leve.col"},
        {FieldBookFormat::Quendal, "leve-quendal.txt", nullptr},
    };
    for (const auto& c : cases) {
        // The book without its end: its last line loses its line end, its transfer marks and a character.
        std::string book = ReadBytes(FieldBookData(c.sample));
        while (!book.empty() && (static_cast<unsigned char>(book.back()) <= ' ' || book.back() == '\x7f'))
            book.pop_back();
        book.pop_back();
        int lines = 0;
        ForEachLine(book, [&lines](std::string_view, int number) { lines = number; });
        const std::string carnet = dir / (std::string("coupé-") + c.sample);
        WriteBytes(carnet, book);
        frontEnd = {};
        frontEnd.answers = {Answer::Yes};
        frontEnd.dialogArguments = {carnet};
        if (c.layout)
            frontEnd.dialogArguments.insert(frontEnd.dialogArguments.end(),
                                            {"--parametrage", FieldBookData(c.layout)});
        EXPECT_EQ(RunConversion(*Make(c.format), nullptr), DialogResult::Ok)
            << c.sample << frontEnd.AllLines();
        std::vector<std::string> told;
        std::copy_if(
            frontEnd.lines.begin(), frontEnd.lines.end(), std::back_inserter(told),
            [](const std::string& line) { return line.find("sans fin de ligne") != std::string::npos; });
        ASSERT_EQ(told.size(), 1u) << c.sample << frontEnd.AllLines();
        EXPECT_TRUE(told[0].starts_with("Attention : ligne " + std::to_string(lines) + " sans fin de ligne"))
            << c.sample << told[0];
    }
}

// Stopped before the reading, a conversion leaves the disk and the open GéoBase as they were.
TEST_F(Conversion, AStoppedConversionTouchesNothing) {
    WriteBytes(dir / "carnet.geo", "ancienne\n");
    const struct {
        const char* what;
        std::vector<std::string> arguments;
        std::vector<Answer> answers;
        bool merge;
        DialogResult result;
    } cases[] = {
        {"GéoBase existante gardée", {dir / "carnet.qdl"}, {Answer::No}, false, DialogResult::Cancel},
        {"table absente, pas d'interprétation refusée",
         {dir / "carnet.qdl", "--interpretation", "1", "--table", dir / "absente.cod"},
         {Answer::No},
         true,
         DialogResult::Cancel},
        {"appareil inconnu", {dir / "carnet.qdl", "--appareil", "Disparu"}, {}, true, DialogResult::Failed},
    };
    for (const auto& c : cases) {
        CCarnet target;
        target.Add(std::make_unique<CComment>("déjà là"), kKindComment);
        frontEnd.answers.assign(c.answers.begin(), c.answers.end());
        EXPECT_EQ(Convert(c.arguments, c.merge ? &target : nullptr), c.result) << c.what;
        EXPECT_EQ(target.GetSize(), 1) << c.what;
        EXPECT_EQ(ReadBytes(dir / "carnet.geo"), "ancienne\n") << c.what;
        EXPECT_FALSE(fs::exists(Params())) << c.what;
        EXPECT_FALSE(fs::exists(dir / "registre")) << c.what;
    }
}

// A GéoBase that cannot be written is named with the reason in words; one that is there stays as it was,
// and the last-file keys too. A GéoBase replaced keeps the access rights the surveyor gave it.
TEST_F(Conversion, AFailedWriteSaysWhyAndLeavesTheLastFileKeysAsTheyWere) {
    const std::string noFolder = dir / "absent/carnet.geo", readOnly = dir / "protégée.geo";
    WriteBytes(readOnly, kJob);
    chmod(readOnly.c_str(), 0444);
    // The field book itself named as the GéoBase to create: "replace it" cannot mean the book.
    const std::string book = dir / "carnet.qdl";
    const struct {
        std::string geoBase;
        const char* reason;
    } cases[] = {
        {noFolder, "(fichier ou dossier inexistant)"},
        {readOnly, "en lecture seule : il est laissé tel qu'il est"},
        {book, "n'est pas une GéoBase : il est laissé tel qu'il est"},
    };
    for (const auto& c : cases) {
        frontEnd = {};
        frontEnd.answers = {Answer::Yes};
        WriteLastGeoBase(Params(), "avant.geo");
        WriteParamString(kRegistrySettings, kSectionPyralis, kKeyDernierFichier, "avant.geo");
        EXPECT_EQ(Convert({dir / "carnet.qdl", "--geobase", c.geoBase}), DialogResult::Failed);
        EXPECT_NE(MessageTexts(frontEnd).find("<" + c.geoBase + ">\n"), std::string::npos);
        EXPECT_NE(MessageTexts(frontEnd).find(c.reason), std::string::npos) << MessageTexts(frontEnd);
        EXPECT_EQ(frontEnd.Failures(), 1);
        EXPECT_EQ(ReadLastGeoBase(Params()), "avant.geo");
        EXPECT_EQ(LastFile(), "avant.geo");
    }
    EXPECT_FALSE(fs::exists(dir / "absent"));
    EXPECT_EQ(ReadBytes(readOnly), kJob);
    EXPECT_EQ(ReadBytes(book), kBook);

    const std::string shared = dir / "partagée.geo";
    WriteBytes(shared, kJob);
    chmod(shared.c_str(), 0664);
    frontEnd = {};
    frontEnd.answers = {Answer::Yes};
    EXPECT_EQ(Convert({dir / "carnet.qdl", "--geobase", shared}), DialogResult::Ok);
    struct stat info {};
    ASSERT_EQ(stat(shared.c_str(), &info), 0);
    EXPECT_EQ(info.st_mode & 0777, 0664u);
    EXPECT_TRUE(ReadBytes(shared).ends_with("POTEAU\n"));
    for (const auto& entry : fs::directory_iterator(dir.Root()))
        EXPECT_NE(entry.path().extension(), ".tmp") << entry.path();
}

// Into the editor's GéoBase: after its elements, in reading order, the instrument first; nothing written.
TEST_F(Conversion, AMergeAppendsInReadingOrderWithTheInstrumentFirst) {
    WriteInstruments(Params(), {{kStandardInstrument}, {"TCR 307", 0.034}});
    CCarnet target;
    target.Add(std::make_unique<CComment>("Levé du 2 mars"), kKindComment);
    target.Add(std::make_unique<CPointGen>("A1", 651050.118, 6862512.447), kKindPoint);
    EditorDocument document{nullptr, ReadInstruments(Params())};
    auto converter = Make(FieldBookFormat::Quendal, &document);
    bool geoBaseShown = true;
    converter->showDialog = [&](CLectCarnet& dialog) {
        geoBaseShown = dialog.GeoBaseFieldVisible();
        return frontEnd.DoModal(dialog);
    };
    frontEnd.dialogArguments = {dir / "carnet.qdl", "--ecrire-appareil", "1", "--appareil", "TCR 307"};
    EXPECT_EQ(RunConversion(*converter, &target), DialogResult::Ok);
    EXPECT_FALSE(geoBaseShown);
    ASSERT_EQ(Kinds(target), (std::vector<int>{kKindComment, kKindPoint, kKindAppareil, kKindStation,
                                               kKindReference, kKindMesure}));
    EXPECT_EQ(target.matAt(2), "TCR 307");
    EXPECT_EQ(target.matAt(5), "102");
    EXPECT_EQ(converter->result.GetSize(), 0);
    EXPECT_FALSE(fs::exists(dir / "carnet.geo"));
    EXPECT_EQ(LastFile(), "");
    // The editor held no code table: this format says it in its own words, the instrument formats in theirs.
    EXPECT_EQ(MessageTexts(frontEnd), "Cas impossible en théorie !!!");
    frontEnd = {};
    auto wild = Make(FieldBookFormat::Wild, &document);
    wild->showDialog = [](CLectCarnet&) { return DialogResult::Cancel; };
    RunConversion(*wild, nullptr);
    EXPECT_EQ(MessageTexts(frontEnd), "Pas de table de codes actuellement chargée !!!");
}

// The default table, named in any case, is neither loaded in place of the job's table nor saved as it;
// without a table of its own the job uses the installation's, which is not saved as its either.
TEST_F(Conversion, TheDefaultCodeTableIsNeitherReloadedNorSaved) {
    const std::string job = dir / "job.cod", other = dir / "autre.cod";
    WriteBytes(job, "Séparateur = A...Z\nPIQ   ExcentRad\n");
    WriteBytes(other, "Séparateur = A...Z\nEXR   ExcentRad\n");
    WriteBytes(dir / "codes.qdl", "STATION;S1;1.5\nCODE;PIQ 0.2\nCODE;EXR 0.15;;12\n");
    const struct {
        const char* table;         // on the command line
        std::string before, kept;  // the key before and after
        int firstKind, secondKind; // how PIQ and EXR were read
    } cases[] = {
        {"DEFAUT.COD", job, job, kKindExcentrement, kKindCommand},
        {"Defaut.cod", job, job, kKindExcentrement, kKindCommand},
        {other.c_str(), job, other, kKindCommand, kKindExcentrement},
        {nullptr, "", "", CommandKind("Sym_sans_Ori"), kKindExcentrement},
    };
    for (const auto& c : cases) {
        WriteParamString(Params(), kSectionGeocodification, kKeyTableDeCode, c.before);
        fs::remove(dir / "codes.geo");
        frontEnd = {};
        frontEnd.dialogArguments = {dir / "codes.qdl", "--interpretation", "1"};
        if (c.table) frontEnd.dialogArguments.insert(frontEnd.dialogArguments.end(), {"--table", c.table});
        auto converter = Make(FieldBookFormat::Quendal);
        ASSERT_EQ(RunConversion(*converter, nullptr), DialogResult::Ok) << c.kept;
        EXPECT_TRUE(frontEnd.questions.empty()) << c.kept;
        EXPECT_EQ(Key(kSectionGeocodification, kKeyTableDeCode), c.kept) << c.kept;
        EXPECT_EQ(converter->codeTable->FileName(), c.table ? c.kept : install + "Config/Defaut.cod");
        CCarnet written;
        ASSERT_TRUE(written.Load(nullptr, dir / "codes.geo"));
        EXPECT_EQ(Kinds(written), (std::vector<int>{kKindStation, c.firstKind, c.secondKind})) << c.kept;
        EXPECT_EQ(written.matAt(2), "12"); // the point the code was written for, interpreted or not
    }
}

// The Wild format's pre-formatting program writes "<name>.tmp", which is read instead and then deleted; a
// zero prism height is told when the format tests it, and that key is read, never written back.
TEST_F(Conversion, TheWildSettingsPreformattingAndZeroPrismHeight) {
    const std::string script = dir / "préformat.sh";
    WriteBytes(script, "#!/bin/sh\nsed 's/^X;/MESURE;/' \"$1\" > \"${1%.*}.tmp\"\n");
    chmod(script.c_str(), 0755);
    const std::string book = "STATION;S1;1.5\nX;101;1.3;10;100;25\n",
                      zero = "STATION;S1;1.5\nMESURE;101;0;10;100;25\n";
    const std::string noProgram =
        "Impossible de trouver le programme de préformattage :\n" + dir / "absent.sh";
    const std::string zeroHp = "Certaines observations ont une hauteur de prisme à zéro !";
    const struct {
        std::string program, testHp, book;
        int size;
        std::string message;
    } cases[] = {
        {script, "0", book, 2, ""},
        {dir / "absent.sh", "0", book, 1, noProgram},
        {"", "1", zero, 2, zeroHp},
        {"", "0", zero, 2, ""},
    };
    for (const auto& c : cases) {
        frontEnd = {};
        fs::remove(dir / "levé.geo");
        WriteBytes(dir / "levé.gsi", c.book);
        WriteParamString(Params(), "Carnet.Wild", kKeyPreformattage, c.program);
        WriteParamString(Params(), "Carnet.Wild", kKeyTestHpNulle, c.testHp);
        EXPECT_EQ(Convert({dir / "levé.gsi"}, nullptr, FieldBookFormat::Wild), DialogResult::Ok) << c.message;
        CCarnet written;
        ASSERT_TRUE(written.Load(nullptr, dir / "levé.geo"));
        EXPECT_EQ(written.GetSize(), c.size) << c.message;
        EXPECT_FALSE(fs::exists(dir / "levé.tmp"));
        EXPECT_EQ(ReadBytes(dir / "levé.gsi"), c.book);
        EXPECT_EQ(MessageTexts(frontEnd), c.message);
        EXPECT_TRUE(c.message != zeroHp || frontEnd.messages.at(0).icon == ui::kIconInformation);
        EXPECT_EQ(c.message == noProgram, Said("Erreur ligne 2 : donnée non reconnue !"));
    }
    EXPECT_EQ(Key("Carnet.Wild", kKeyTestHpNulle), "0");
    EXPECT_EQ(Key("Carnet.Wild", kKeyParametrage), install + "Config/Wild.ini");
}

// A GSI field book through its own reader, a comment naming the book; the files named from the folder
// the command runs in are recorded whole: the next reading finds them from any other folder.
TEST_F(Conversion, AWildFieldBookIsReadByItsOwnReaderWithFilesNamedFromTheCurrentFolder) {
    fs::copy_file(install + "Config/Wild.ini", dir / "chantier-wild.ini");
    fs::copy_file(FieldBookData("wild-gsi16-84.gsi"), dir / "levé.gsi");
    const fs::path before = fs::current_path();
    fs::current_path(dir.Root());
    frontEnd.dialogArguments = {"levé.gsi", "--parametrage", "chantier-wild.ini"};
    const DialogResult result = RunConversion(*Make(FieldBookFormat::Wild), nullptr);
    fs::current_path(before);
    ASSERT_EQ(result, DialogResult::Ok);
    EXPECT_EQ(Key("Carnet.Wild", kKeyParametrage), dir / "chantier-wild.ini");
    EXPECT_EQ(ReadLastGeoBase(Params()), dir / "levé.geo");
    CCarnet written;
    ASSERT_TRUE(written.Load(nullptr, dir / "levé.geo"));
    ASSERT_EQ(written.GetSize(), 18);
    EXPECT_EQ(written.As<CComment>(0)->text(), "Fichier              = levé.gsi");
    EXPECT_EQ(written.GetType(10), kKindReference);
}

// A delimited field book goes through a Quendal-Pc file beside it, read with the same choices and the
// editor's code table, then deleted.
TEST_F(Conversion, ADelimitedFieldBookIsReadThroughAQuendalFile) {
    fs::copy_file(std::string(PYR_SOURCE_DIR) + "/data/Config/Param_Export.sep",
                  install + "Config/Param_Export.sep");
    WriteBytes(dir / "points.txt", "PT;P1;10;20;30\nCD;EXR 0.15\nPT;P2;11;21\n");
    // The importer hands the records, as the delimited layout would read them.
    RecordImporter importer = [&](const CParamDriver& layout, const std::string& carnet, CCarnet& records,
                                  CPyrTxtWnd*, ui::FrontEnd*, const RecordDrain&) {
        EXPECT_EQ(layout.Layout().typePoint, "PT");
        EXPECT_EQ(carnet, dir / "points.txt");
        records.Add(std::make_unique<CPointGen>("P1", 10.0, 20.0, 30.0), kKindPoint);
        records.Add(std::make_unique<CCommande>("EXR 0.15"), kKindCommand);
        records.Add(std::make_unique<CPointGen>("P2", 11.0, 21.0), kKindPoint);
        return true;
    };
    CTableCode table;
    ASSERT_TRUE(table.Init(DefaultCodeTable()));
    EditorDocument document{&table, {}};
    auto converter = Make(FieldBookFormat::Separateur, &document);
    converter->makeReader = [&] { return std::make_unique<CQuendalPivot>(importer); };
    std::string named; // the editor's table, named in the dialog
    converter->showDialog = [&](CLectCarnet& dialog) {
        named = dialog.CodeTablePath();
        return frontEnd.DoModal(dialog);
    };
    frontEnd.dialogArguments = {dir / "points.txt", "--interpretation", "1"};
    CCarnet target;
    ASSERT_EQ(RunConversion(*converter, &target), DialogResult::Ok) << frontEnd.AllLines();
    EXPECT_EQ(named, DefaultCodeTable());
    EXPECT_EQ(converter->codeTable, &table);
    EXPECT_FALSE(fs::exists(dir / "points.tmp"));
    ASSERT_EQ(target.GetSize(), 3);
    EXPECT_EQ(target.GetType(1), kKindExcentrement);
    EXPECT_EQ(target.zAt(2), kUndefined);
    EXPECT_EQ(std::count(frontEnd.lines.begin(), frontEnd.lines.end(), "Création de la GéoBase en cours ..."),
              1);
    EXPECT_EQ(frontEnd.lines.back(), " ... terminée : 3 lignes écrites.");
}

// The records go to the Quendal-Pc file by batches as they are read: an import that stops after a batch
// was written leaves no file behind and adds nothing to the GéoBase.
TEST_F(Conversion, AnImportStoppedHalfwayLeavesNoQuendalFileAndAddsNothing) {
    fs::copy_file(std::string(PYR_SOURCE_DIR) + "/data/Config/Param_Export.sep",
                  install + "Config/Param_Export.sep");
    WriteBytes(dir / "points.txt", "PT;P1;10;20;30\n");
    bool drained = false;
    RecordImporter importer = [&](const CParamDriver&, const std::string&, CCarnet& records, CPyrTxtWnd*,
                                  ui::FrontEnd*, const RecordDrain& drain) {
        records.Add(std::make_unique<CPointGen>("P1", 10.0, 20.0, 30.0), kKindPoint);
        drain(records);
        drained = records.IsEmpty() && fs::exists(dir / "points.tmp"); // the batch went to the file
        return false; // a file that could not be read to its end
    };
    auto converter = Make(FieldBookFormat::Separateur);
    converter->makeReader = [&] { return std::make_unique<CQuendalPivot>(importer); };
    frontEnd.dialogArguments = {dir / "points.txt"};
    CCarnet target;
    EXPECT_NE(RunConversion(*converter, &target), DialogResult::Ok);
    EXPECT_TRUE(drained);
    EXPECT_TRUE(target.IsEmpty());
    for (const auto& entry : fs::directory_iterator(dir.Root()))
        EXPECT_EQ(entry.path().string().find(".tmp"), std::string::npos) << entry.path();
}
