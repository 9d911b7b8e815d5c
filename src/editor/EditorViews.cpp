#include "editor/EditorViews.h"

#include "core/Strings.h"
#include "editor/GeoEditor.h"
#include "geobase/Kinds.h"

#include <algorithm>

namespace pyr {

namespace {

using K = FieldKey;

} // namespace

const std::vector<EditorView>& EditorViews() {
    static const std::vector<EditorView> views{
        {"Tous les éléments", {}, {}},
        {"Stations et visées",
         {kKindStation, kKindReference, kKindMesure},
         {{"Matricule", {K::Matricule}},
          {"HI / HP", {K::HI, K::HP}},
          {"V0 / AH", {K::V0, K::AH}},
          {"AV", {K::AV}},
          {"DI", {K::DI}},
          {"Code", {K::Code}}}},
        {"Points",
         {kKindPoint},
         {{"Matricule", {K::Matricule}},
          {"X", {K::X}},
          {"Y", {K::Y}},
          {"Z", {K::Z}},
          {"XY inv.", {K::InvariantXY}},
          {"Z inv.", {K::InvariantZ}},
          {"Code", {K::Code}}}},
        {"Nivellement",
         {kKindLectAR, kKindLectAV},
         {{"Matricule", {K::Matricule}},
          {"Lecture", {K::Lecture}},
          {"Distance", {K::Distance}},
          {"Code", {K::Code}}}},
        {"Cheminements",
         {kKindChemin},
         {{"Nom", {K::Matricule}}, {"Stations", {K::Stations}}, {"Fermé", {K::Ferme}}}},
        {"Appareils",
         {kKindAppareil},
         {{"Nom", {K::Matricule}},
          {"Coll. V", {K::CollVerticale}},
          {"Cte prisme", {K::ConstPrisme}},
          {"σ AH", {K::SigmaAh}},
          {"σ AV", {K::SigmaAv}},
          {"σ DI", {K::SigmaDi}},
          {"σ ppm", {K::SigmaPpm}}}},
        {"Commentaires", {kKindComment}, {{"Texte", {K::Texte}}}},
    };
    return views;
}

std::vector<std::string> ViewHeadings(const EditorView& view) {
    if (view.columns.empty()) return {"N°", "Élément", "Valeurs"};
    std::vector<std::string> headings{"N°"};
    if (view.kinds.size() > 1) headings.emplace_back("Élément");
    for (const ViewColumn& column : view.columns)
        headings.emplace_back(column.heading);
    return headings;
}

std::vector<int> ViewIndices(const CCarnet& carnet, const EditorView& view) {
    std::vector<int> indices;
    if (view.kinds.empty()) return indices;
    for (int i = 0; i < carnet.GetSize(); ++i)
        if (std::find(view.kinds.begin(), view.kinds.end(), carnet.GetType(i)) != view.kinds.end())
            indices.push_back(i);
    return indices;
}

std::string ViewRow(const CCarnet& carnet, const EditorView& view, int index) {
    if (view.columns.empty()) return EditorRow(carnet, index);
    const int kind = carnet.GetType(index);
    std::string row = Sprintf("%06d", index + 1);
    if (view.kinds.size() > 1) (row += '\t') += KindLabel(kind);
    for (const ViewColumn& column : view.columns) {
        row += '\t';
        for (FieldKey key : column.keys)
            if (FindField(kind, key)) {
                row += FieldText(carnet, index, key);
                break;
            }
    }
    return row;
}

} // namespace pyr
