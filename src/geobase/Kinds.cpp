#include "geobase/Kinds.h"

#include "core/Strings.h"

#include <array>

namespace pyr {

namespace {

struct CommandEntry {
    std::string_view word;
    std::string_view description;
};

// Codes 1011 to 1065, in code order.
constexpr std::array<CommandEntry, 55> kInterpretedCommands{{
    {"PT_Sans_Ori", "Pt topo : sans orientation"},
    {"PT_Avec_Ori", "Pt topo : avec orientation"},
    {"Déf_Ori_PT", "Pt topo : définition de l'orientation"},
    {"Annul_Ori_PT", "Pt topo : annulation de l'orientation"},
    {"Déf_Ori_SY", "Symb : définition de l'orientation"},
    {"Annul_Ori_SY", "Symb : annulation de l'orientation"},
    {"Sym_sans_Ori", "Symb : sans orientation"},
    {"Sym_Cir_Ray", "Symb : circulaire par centre+rayon ou centre+point"},
    {"Sym_Cir_Dia", "Symb : circulaire par diamètre"},
    {"Sym_Cir_3Pt", "Symb : circulaire par 3 points"},
    {"Sym_Orienté", "Symb : orienté"},
    {"Sym_Ori_EX", "Symb : orienté, échelle en X"},
    {"Sym_Car_Dia", "Symb : carré par diagonale"},
    {"Sym_Fixe_2Pt", "Symb : fixe par 2 points"},
    {"Sym_2Pts", "Symb : par 2 points - EchX = Dist, EchY = Par1"},
    {"Sym_2Pt_EX", "Symb : par 2 points, échelle en X"},
    {"Sym_2Pt_EY", "Symb : par 2 points, échelle en Y"},
    {"Sym_3Pts_H", "Symb : par 3 points - EchX = D12, EchY = D23"},
    {"Sym_3Pts_D", "Symb : par 3 points (diagonale)"},
    {"Sym_Comp_1", "Symb : composé 1"},
    {"Sym_Comp_2", "Symb : composé 2"},
    {"Sym_Comp_3", "Symb : composé 3"},
    {"Sym_Entrée", "Symb : entrée"},
    {"Sym_Aligne", "Symb : aligné"},
    {"Cercle_R", "Polyligne : cercle par centre et rayon"},
    {"Cercle_D", "Polyligne : cercle par diamètre"},
    {"Cercle_3Pts", "Polyligne : cercle par 3 points"},
    {"Carré_Dia", "Polyligne : carré par diagonale"},
    {"Carré_2Pts", "Polyligne : carré par 2 points"},
    {"Rect_3Pts_H", "Polyligne : rectangle par 3 points (hauteur)"},
    {"Rect_3Pts_D", "Polyligne : rectangle par 3 points (diagonale)"},
    {"Liaison", "Liaison : au point précédent"},
    {"Perp_Segment", "Liaison : perpendiculaire au dernier segment"},
    {"Alignement", "Liaison : alignement"},
    {"Prol_Segment", "Liaison : prolongement du dernier segment"},
    {"Inter_Segment", "Liaison : intersection de segments"},
    {"Parallèle", "Liaison : parallèle"},
    {"Escalier_1", "Escalier : par 4 points, largeur de marche"},
    {"Escalier_2", "Escalier : type 2"},
    {"Escalier_3", "Escalier : type 3"},
    {"Escalier_4", "Escalier : type 4"},
    {"Escalier_5", "Escalier : type 5"},
    {"Passage_Piéton", "Divers : passage piéton"},
    {"Passage_Vélo", "Divers : passage vélo"},
    {"Texte_1Pt", "Texte : par 1 point"},
    {"Texte_Orienté", "Texte : orienté"},
    {"Cache_Attrib", "Attribut : cacher"},
    {"Ajout_Attrib", "Attribut : ajouter"},
    {"Attrib_Point", "Attribut : du point"},
    {"Accro_Pt_Pro", "Divers : accrochage sur point proche"},
    {"Accro_Li_Pro", "Divers : accrochage sur liaison proche"},
    {"Rappel_Point", "Divers : rappel d'un point"},
    {"Perp_2Pts", "Construction : perpendiculaire par 2 points"},
    {"Symétrique", "Construction : symétrique"},
    {"Inter_Dist", "Construction : Intersection par les distances"},
}};

constexpr CommandEntry kGenericCommand{"Commande", "Commande non interprétée"};
constexpr std::array<CommandEntry, 3> kEccentricCommands{{
    {kExcentRad, "Excentrement radial"},
    {kExcentTan, "Excentrement tangentiel"},
    {kExcentVer, "Excentrement vertical"},
}};

} // namespace

std::string_view CommandWord(int kind) {
    if (kind == kKindCommand) return kGenericCommand.word;
    if (kind == kKindExcentrement) return kEccentricCommands[0].word;
    if (kind > kKindExcentrement && kind <= kKindLastCommand)
        return kInterpretedCommands[static_cast<size_t>(kind - kKindExcentrement - 1)].word;
    return {};
}

std::string_view CommandDescription(std::string_view word) {
    if (EqualIgnoringCase(word, kGenericCommand.word)) return kGenericCommand.description;
    for (const auto& entry : kEccentricCommands)
        if (EqualIgnoringCase(word, entry.word)) return entry.description;
    for (const auto& entry : kInterpretedCommands)
        if (EqualIgnoringCase(word, entry.word)) return entry.description;
    return {};
}

int CommandKind(std::string_view word) {
    for (const auto& entry : kEccentricCommands)
        if (EqualIgnoringCase(word, entry.word)) return kKindExcentrement;
    for (size_t i = 0; i < kInterpretedCommands.size(); ++i)
        if (EqualIgnoringCase(word, kInterpretedCommands[i].word))
            return kKindExcentrement + 1 + static_cast<int>(i);
    return kKindCommand;
}

std::string_view AddedReport(int kind) {
    switch (kind) {
    case kKindComment:
        return "Commentaire ajouté dans la GéoBase";
    case kKindStation:
        return "Station <%s> ajoutée dans la GéoBase";
    case kKindReference:
        return "Référence <%s> ajoutée dans la GéoBase";
    case kKindMesure:
        return "Mesure <%s> ajoutée dans la GéoBase";
    case kKindLectAR:
        return "Lecture AR de nivellement <%s> ajoutée dans la GéoBase";
    case kKindLectAV:
        return "Lecture AV de nivellement <%s> ajoutée dans la GéoBase";
    case kKindPoint:
        return "Point <%s> ajouté dans la GéoBase";
    case kKindChemin:
        return "Cheminement <%s> ajouté dans la GéoBase";
    case kKindAppareil:
        return "Appareil <%s> ajouté dans la GéoBase";
    default:
        return IsCommandKind(kind) ? "Commande ajoutée dans la GéoBase" : std::string_view{};
    }
}

std::string_view KindLabel(int kind) {
    switch (kind) {
    case kKindComment:
        return "Commentaire";
    case kKindStation:
        return "Station";
    case kKindReference:
        return "Référence";
    case kKindMesure:
        return "Mesure";
    case kKindLectAR:
        return "Lecture AR";
    case kKindLectAV:
        return "Lecture AV";
    case kKindPoint:
        return "Point";
    case kKindChemin:
        return "Cheminement";
    case kKindAppareil:
        return "Appareil";
    case kKindExcentrement:
        return "Excentrement";
    default:
        return IsCommandKind(kind) ? "Commande" : "Inconnu";
    }
}

} // namespace pyr
