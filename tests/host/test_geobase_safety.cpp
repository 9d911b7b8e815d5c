// The GéoBase is never lost, as a person or a script running pyralis sees it: a raw field book is never
// written over as a GéoBase, a protected GéoBase stays as it is, a full disk leaves the GéoBase and its
// backup as they were, and the surveyor's own files beside it are never touched.
#include "HostTestSupport.h"

namespace {

// Two small Wild GSI-8 books: a station and its sightings.
constexpr const char* kWildBook = "410001+0000STA1 42....+00001.55 \r\n"
                                  "110002+00000001 21.102+00000000 22.102+10000000 31..00+00025000 \r\n"
                                  "110003+00000002 21.102+05000000 22.102+09500000 31..00+00030000 \r\n";
constexpr const char* kOtherWildBook = "410001+0000STA2 42....+00001.62 \r\n"
                                       "110002+0000STA1 21.102+20000000 22.102+10000000 31..00+00050000 \r\n";
using GeoBaseSafety = PyralisTest;

TEST_F(GeoBaseSafety, TheEditorNeverWritesAGeoBaseOverARawFieldBookNorOverItsBackup) {
    WriteBytes(dir / "carnet.gsi", kWildBook);
    WriteBytes(dir / "autre.gsi", kOtherWildBook);
    WriteBytes(dir / "carnet.bak", "copie d'un autre jour\n");
    for (int run = 1; run <= 2; ++run) {
        const Outcome outcome = Run("--oui GeoEdit carnet.gsi --lecture Wild autre.gsi");
        EXPECT_EQ(outcome.status, 1) << run << "\n" << outcome.err;
        EXPECT_TRUE(Has(outcome.out, "<carnet.gsi> n'est pas une GéoBase (3 ligne(s) illisible(s) sur 3)"))
            << outcome.out;
        EXPECT_TRUE(Has(outcome.err, "sous\ncarnet.gsi !\nCe fichier n'est pas une GéoBase")) << outcome.err;
        EXPECT_EQ(ReadBytes(dir / "carnet.gsi"), kWildBook);
        EXPECT_EQ(ReadBytes(dir / "carnet.bak"), "copie d'un autre jour\n");
    }
}

TEST_F(GeoBaseSafety, AReadOnlyGeoBaseIsComputedButNotWrittenEvenByRoot) {
    const std::string before = Demo("chantier.geo");
    ASSERT_EQ(chmod((dir / "chantier.geo").c_str(), 0444), 0);

    const Outcome outcome = Run("CalculV0 --geobase chantier.geo --type toutes --enregistrer --non");
    EXPECT_EQ(outcome.status, 1) << outcome.err;
    EXPECT_TRUE(Has(outcome.out,
                    "GéoBase <chantier.geo> en lecture seule : elle peut être lue et calculée, mais "
                    "ses résultats ne pourront pas y être enregistrés."))
        << outcome.out;
    EXPECT_TRUE(Has(outcome.out, "Station S1(1) : V0 = ")) << outcome.out;
    EXPECT_TRUE(Has(outcome.err,
                    "Impossible d'enregistrer la GéoBase sous\nchantier.geo !\nCe fichier est en "
                    "lecture seule : il est laissé tel qu'il est."))
        << outcome.err;
    EXPECT_EQ(ReadBytes(dir / "chantier.geo"), before);
    EXPECT_FALSE(std::filesystem::exists(dir / "chantier.bak")) << "no backup of a file that is not saved";
}

// The GéoBase in a folder of its own, so that whatever a save leaves behind shows.
class GeoBaseUnderSizeLimit : public GeoBaseSafety {
protected:
    GeoBaseUnderSizeLimit() {
        std::filesystem::create_directory(dir.Root() / "travail");
        WriteBytes(dir / "carnet.qdl", kQuendalBook);
    }
    std::string Geo() const { return dir / "travail/job.geo"; }
    std::string Bak() const { return dir / "travail/job.bak"; }
    Outcome Read(rlim_t limit) {
        return Run("--oui GeoEdit travail/job.geo --lecture Quendal carnet.qdl", limit);
    }

    // A GéoBase of a few hundred points, as big as a small job.
    static std::string Job() {
        std::string job = "GEOBASE PYRALIS\t1\n";
        for (int i = 0; i < 200; ++i)
            job += "1006\tP" + std::to_string(i) + "\t651000.125\t6862000.5\t52.3\t-\tBORNE\n";
        return job;
    }
};

// A save that does not fit, and a backup that does not fit (an older backup, bigger than the limit): the
// GéoBase, its backup and the folder stay as they were.
TEST_F(GeoBaseUnderSizeLimit, ASaveOrABackupThatDoesNotFitLeavesTheGeoBaseItsBackupAndNoTemporaryFile) {
    const std::string job = Job();
    const struct {
        std::string backup;
        rlim_t limit;
        const char* said;
    } cases[] = {
        // As after the last save, the backup holds what the GéoBase holds: the backup of this save succeeds.
        {job, job.size() + std::string(kQuendalLines).size() - 1,
         "Impossible d'enregistrer la GéoBase sous\ntravail/job.geo !\n(fichier trop grand pour la limite de "
         "taille permise).\nLe fichier est resté tel qu'il était."},
        {std::string(4000, '#'), 2048,
         "Impossible de faire la copie de sauvegarde de la GéoBase\ntravail/job.geo\ndans\ntravail/job.bak\n"
         "(fichier trop grand pour la limite de taille permise)."},
    };
    for (const auto& c : cases) {
        WriteBytes(Geo(), job);
        WriteBytes(Bak(), c.backup);
        const auto names = FileNames(dir.Root() / "travail");
        const Outcome outcome = Read(c.limit);
        EXPECT_EQ(outcome.status, 1) << outcome.err;
        EXPECT_TRUE(Has(outcome.err, c.said)) << outcome.err;
        EXPECT_EQ(ReadBytes(Geo()), job);
        EXPECT_EQ(ReadBytes(Bak()), c.backup);
        EXPECT_EQ(FileNames(dir.Root() / "travail"), names);
    }
    // Without the limit, the very same command saves: the limit was all that stopped it.
    const Outcome saved = Read(RLIM_INFINITY);
    EXPECT_EQ(saved.status, 0) << saved.err;
    EXPECT_EQ(ReadBytes(Geo()), job + kQuendalLines);
}

TEST_F(GeoBaseSafety, AFileOfTheSurveyorsNamedLikeTheGeoBaseSurvivesASave) {
    WriteBytes(dir / "carnet.qdl", kQuendalBook);
    WriteBytes(dir / "chantier.geo", "GEOBASE PYRALIS\t1\n");
    WriteBytes(dir / "chantier.tmp", "mes notes de terrain\n");
    const Outcome outcome = Run("--oui GeoEdit chantier.geo --lecture Quendal carnet.qdl");
    EXPECT_EQ(outcome.status, 0) << outcome.err;
    EXPECT_EQ(ReadBytes(dir / "chantier.geo"), std::string("GEOBASE PYRALIS\t1\n") + kQuendalLines);
    EXPECT_EQ(ReadBytes(dir / "chantier.tmp"), "mes notes de terrain\n");
    EXPECT_EQ(ReadBytes(dir / "chantier.bak"), "GEOBASE PYRALIS\t1\n");
}

} // namespace
