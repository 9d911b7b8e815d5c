#pragma once

// P sighted from three stations whose places and orientations are known, Q from one of them only: the
// job of the intersection window's tests, its point known beforehand.
#include "TestSupport.h"
#include "calc/CalcInters.h"
#include "calc/test_v0_geometry.h"
#include "ui/ScriptedFrontEnd.h"

#include <string>

namespace pyr::test {

// Listings in plain text beside the GéoBase, without a question of their names.
inline constexpr const char* kPlainListingOptions =
    "[Options_Listings]\nChoixNomListing=0\nAfficherListing=0\n[Listings]\nFormat=2\n";

struct IntersectionJob {
    static constexpr Place kP{1050.0, 2080.0, 103.2};
    CCarnet job;

    IntersectionJob() {
        const Place s1{1000.0, 2000.0, 100.0}, s2{1100.0, 2000.0, 101.0}, s3{1120.0, 2150.0, 99.0};
        for (const auto& [name, place] : {std::pair{"S1", s1}, {"S2", s2}, {"S3", s3}})
            AddPoint(job, name, place);
        AddStation(job, "S1", 1.5, 50.0);
        AddSighting(job, "P", s1, 1.5, kP, 1.3, 50.0, kKindMesure);
        AddStation(job, "S2", 1.6, 120.0);
        AddSighting(job, "P", s2, 1.6, kP, 1.3, 120.0, kKindMesure);
        AddSighting(job, "Q", s2, 1.6, {1180.0, 2050.0, 100.0}, 1.3, 120.0, kKindMesure);
        AddStation(job, "S3", 1.45, 333.3);
        AddSighting(job, "P", s3, 1.45, kP, 1.3, 333.3, kKindMesure);
    }

    // The job saved in `dir` as "chantier.geo", beside a parameter file for plain listings: its path.
    std::string Prepare(const TempDir& dir) {
        WriteBytes(dir / "Pyralis.ini", kPlainListingOptions);
        job.Save(dir / "chantier.geo");
        return dir / "chantier.geo";
    }

    // The GéoBase the model leaves when P is chosen, every sighting taken, P written and the dialog
    // finished with the listing, the GéoBase saved: what a window must leave after the same actions.
    static std::string ByTheModel(ui::ScriptedFrontEnd& frontEnd) {
        TempDir dir;
        IntersectionJob same;
        CCalcInters model;
        model.SetInputs({same.Prepare(dir), dir / "Pyralis.ini", "", ""});
        if (!model.Open(frontEnd) || !model.ChoosePoint("P")) return {};
        model.AddAll();
        if (!model.WritePoint()) return {};
        frontEnd.answers = {ui::Answer::Yes};
        model.FinishWithListing();
        return ReadBytes(dir / "chantier.geo");
    }
};

} // namespace pyr::test
