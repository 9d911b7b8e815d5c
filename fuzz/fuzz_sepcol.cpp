// Any bytes read as a delimited or columnar field book, by one of a few layouts chosen by the first byte.
// Nothing may crash, and the records imported are fit for the Quendal pivot:
//  - every number is a finite value or the undefined value (never NaN nor an infinity);
//  - written as a Quendal-Pc field book and read back, no line of it is refused as unreadable (the lines of
//    the surveyor's file are reported by the import with their own numbers, never by the pivot's reading
//    with the numbers of the temporary file), and the comments and field codes come back word for word.
#include "FuzzRoundTrip.h"
#include "core/TextEncoding.h"
#include "fieldbook/ConfigCol.h"
#include "fieldbook/ConfigQdl.h"
#include "fieldbook/ConfigSep.h"
#include "fieldbook/QuendalReader.h"
#include "geobase/Carnet.h"
#include "ui/PyrTxtWnd.h"
#include "ui/ScriptedFrontEnd.h"

#include <cmath>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace {

using namespace pyr;

[[noreturn]] void Broken(const char* what, std::string_view detail) {
    fuzz::Broken("fuzz_sepcol", what, detail);
}

struct Layout {
    FieldBookFormat format;
    std::vector<std::pair<const char*, const char*>> keys; // over the defaults of the format
};

const std::vector<Layout>& Layouts() {
    static const std::vector<Layout> layouts{
        {FieldBookFormat::Separateur, {}},
        {FieldBookFormat::Separateur,
         {{kKeySeparateur, "TAB"},
          {kKeySeparateurDecimal, ","},
          {kKeyLignesEntete, "1"},
          {kKeyUniteAngles, "dms"},
          {kKeyUniteDistances, "pieds"},
          {kKeyChampsStation, "TYPE,MATRICULE,HI,V0,CODE"}}},
        {FieldBookFormat::Separateur,
         {{kKeySeparateur, "ESPACE"},
          {kKeyChampsStation, ""},
          {kKeyChampsVisee, ""},
          {kKeyChampsPoint, "MATRICULE,X,Y,Z,CODE"}}},
        {FieldBookFormat::Separateur,
         {{kKeySeparateur, " | "},
          {kKeyUniteAngles, "degres"},
          {kKeyTypeCommentaire, "*"},
          {kKeyChampsVisee, "MATRICULE,IGNORE,TYPE,AH,AV,DI,HP"}}},
        {FieldBookFormat::Colonne, {}},
        {FieldBookFormat::Colonne,
         {{kKeySeparateurDecimal, ","},
          {kKeyUniteAngles, "mils"},
          {kKeyChampsStation, ""},
          {kKeyChampsVisee, ""},
          {kKeyChampsPoint, "MATRICULE:1-8,X:9-20,Y:21-32,Z:30-40,CODE:41-"}}},
        {FieldBookFormat::Colonne,
         {{kKeyTypeStation, "S"},
          {kKeyTypeReference, "R"},
          {kKeyTypeMesure, "M"},
          {kKeyTypePoint, "P"},
          {kKeyTypeCode, "C"},
          {kKeyTypeCommentaire, "*"},
          {kKeyChampsStation, "TYPE:1-1,MATRICULE:3-12,HI:14-20,V0:22-31,CODE:33-"},
          {kKeyChampsVisee, "TYPE:1-1,MATRICULE:3-12,HP:14-20,AH:22-31,AV:33-42,DI:44-53,CODE:55-"},
          {kKeyChampsPoint, "TYPE:1-1,MATRICULE:3-12,X:14-27,Y:29-42,Z:44-51,CODE:53-"}}},
    };
    return layouts;
}

bool Fit(double value) {
    return std::isfinite(value);
}

void CheckNumbers(const CCarnet& records) {
    for (int i = 0; i < records.GetSize(); ++i) {
        for (double value : {records.xAt(i), records.yAt(i), records.zAt(i), records.ahAt(i), records.avAt(i),
                             records.diAt(i), records.hiAt(i), records.hpAt(i), records.v0At(i)})
            if (!Fit(value)) Broken("un nombre importé n'est pas fini", records.matAt(i));
    }
}

// The texts of the comments and field codes, in their order.
std::vector<std::string> Texts(const CCarnet& carnet) {
    std::vector<std::string> texts;
    for (int i = 0; i < carnet.GetSize(); ++i) {
        if (carnet.GetType(i) == kKindComment)
            texts.push_back("C " + carnet.As<CComment>(i)->text());
        else if (carnet.GetType(i) == kKindCommand)
            texts.push_back("D " + carnet.cmdAt(i));
    }
    return texts;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    if (size == 0) return 0;
    const Layout& chosen = Layouts()[data[0] % Layouts().size()];
    CParamDriver layout("", "", chosen.format);
    for (const auto& [key, value] : chosen.keys)
        layout.SetText(key, value);
    if (!layout.Validate().empty()) Broken("une disposition du fuzz est incorrecte", layout.Validate());
    const std::string text =
        FileBytesToUtf8(std::string_view(reinterpret_cast<const char*>(data) + 1, size - 1));

    ui::ScriptedFrontEnd frontEnd;
    ui::ScopedApplicationFrontEnd scope(frontEnd);
    CPyrTxtWnd txt(frontEnd);
    CCarnet records;
    if (chosen.format == FieldBookFormat::Colonne)
        CDlgConfigCol::ImportText(layout, text, records, &txt);
    else
        CDlgConfigSep::ImportText(layout, text, records, &txt);
    CheckNumbers(records);

    const std::string quendal = CDlgConfigQdl::Text(records);
    ui::ScriptedFrontEnd pivotFrontEnd;
    CPyrTxtWnd pivotTxt(pivotFrontEnd);
    CQuendalReader reader;
    reader.SetTextWindow(&pivotTxt);
    reader.SetParent(&pivotFrontEnd);
    reader.SetAnnounced(false);
    CCarnet geoBase;
    reader.ReadText(quendal, geoBase);
    for (const std::string& line : pivotFrontEnd.lines)
        if (line.starts_with("Erreur ligne") || line.starts_with("Attention : ligne"))
            Broken("le carnet Quendal-Pc des enregistrements a une ligne refusée", line + "\n" + quendal);
    if (Texts(geoBase) != Texts(records)) Broken("les commentaires ou les codes changent en route", quendal);
    return 0;
}
