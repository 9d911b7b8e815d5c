#include "settings/ListingKinds.h"

#include <array>

namespace pyr {

namespace {

constexpr std::array<ListingKindInfo, kListingKindCount> kKinds = {{
    {ListingKind::BlockAdjustment, "Listing de calcul en bloc (*.cbl)", "cbl", "Listing de calcul en bloc",
     "PYRALIS CALCULS TOPOMETRIQUES - CALCUL EN BLOC D'UN RESEAU", kListingQuestionCalculations},
    {ListingKind::EccentricStation, "Listing de station décalée (*.cex)", "cex", "Listing de station décalée",
     "PYRALIS CALCULS TOPOMETRIQUES - CALCUL DE STATIONS EXCENTREES", kListingQuestionCalculations},
    {ListingKind::Intersection, "Listing d'intersection (*.cin)", "cin", "Listing d'intersection",
     "PYRALIS CALCULS TOPOMETRIQUES - CALCUL PAR INTERSECTION", kListingQuestionCalculations},
    {ListingKind::Recoupement, "Listing de recoupement (*.crc)", "crc", "Listing d'intersection",
     "PYRALIS CALCULS TOPOMETRIQUES - CALCUL PAR RECOUPEMENT", kListingQuestionCalculations},
    {ListingKind::Resection, "Listing de relèvement (*.crl)", "crl", "Listing de relèvement",
     "PYRALIS CALCULS TOPOMETRIQUES - CALCUL PAR RELEVEMENT", kListingQuestionCalculations},
    {ListingKind::Triangulation, "Listing de triangulation (*.ctr)", "ctr", "Listing de triangulation",
     "PYRALIS CALCULS TOPOMETRIQUES - CALCUL PAR TRIANGULATION", kListingQuestionCalculations},
    {ListingKind::StationV0, "Listing de calcul de V0 (*.cv0)", "cv0", "Listing de calcul de V0",
     "PYRALIS CALCULS TOPOMETRIQUES - CALCUL DES V0 DE STATIONS", kListingQuestionV0},
    {ListingKind::CoherenceCheck, "Listing de contrôle de cohérence (*.ver)", "ver",
     "Listing de contrôle de cohérence", "PYRALIS CALCULS TOPOMETRIQUES - CONTROLE DE COHERENCE",
     kListingQuestionTreatments},
    {ListingKind::PrecisionCheck, "Listing de contrôle de précision (*.ctl)", "ctl",
     "Listing de contrôle de précision", "PYRALIS CALCULS TOPOMETRIQUES - CONTROLE DE PRECISION",
     kListingQuestionPrecisionCheck},
    {ListingKind::DuplicatePoints, "Listing de points doubles (*.ptd)", "ptd", "Listing de points doubles",
     "PYRALIS CALCULS TOPOMETRIQUES - RECHERCHE DES POINTS DOUBLES", kListingQuestionTreatments},
    {ListingKind::LevellingDoubleRun, "Listing de nivellement A/R (*.cna)", "cna",
     "Listing de nivellement A/R", "PYRALIS CALCULS TOPOMETRIQUES - NIVELLEMENT ALLER ET RETOUR",
     kListingQuestionCalculations},
    {ListingKind::LevellingSimple, "Listing de nivellement simple (*.cns)", "cns",
     "Listing de nivellement simple", "PYRALIS CALCULS TOPOMETRIQUES - NIVELLEMENT SIMPLE",
     kListingQuestionCalculations},
    {ListingKind::Traverse, "Listing de cheminement (*.ccp)", "ccp", "Listing de cheminement",
     "PYRALIS CALCULS TOPOMETRIQUES - CALCUL DE CHEMINEMENTS", kListingQuestionCalculations},
    {ListingKind::RadiatedPoints, "Listing de points rayonnés (*.cpr)", "cpr", "Listing de points rayonnés",
     "PYRALIS CALCULS TOPOMETRIQUES - CALCUL DE POINTS RAYONNES", kListingQuestionCalculations},
}};

} // namespace

const ListingKindInfo& ListingKindOf(ListingKind kind) {
    return kKinds[static_cast<std::size_t>(kind)];
}

std::string ListingExtension(ListingKind kind, bool richText) {
    return std::string(richText ? std::string_view("rtf") : ListingKindOf(kind).extension);
}

std::string ListingLabel(ListingKind kind, bool richText) {
    const ListingKindInfo& info = ListingKindOf(kind);
    if (!richText) return std::string(info.label);
    return std::string(info.rtfWords) + " (*.rtf)";
}

std::string ListingFilter(ListingKind kind, bool richText) {
    return ListingLabel(kind, richText) + "|*." + ListingExtension(kind, richText) + "||";
}

} // namespace pyr
