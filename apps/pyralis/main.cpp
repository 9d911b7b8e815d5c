// pyralis GEOBASE [COPIE]: reads a GéoBase, shows what it holds, and saves it under a new name.
#include "core/Numbers.h"
#include "core/TextEncoding.h"
#include "geobase/Carnet.h"
#include "ui/ConsoleFrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <cstdio>
#include <map>
#include <string>

using namespace pyr;

namespace {

std::string Value(double value, int decimals) {
    return IsKnown(value) ? FormatFixed(value, decimals) : std::string("inconnu");
}

void ShowContents(CPyrTxtWnd& txt, const CCarnet& carnet) {
    txt.Print("%d éléments :", carnet.GetSize());
    std::map<int, int> counts;
    for (int i = 0; i < carnet.GetSize(); ++i)
        ++counts[IsCommandKind(carnet.GetType(i)) && carnet.GetType(i) != kKindExcentrement
                     ? kKindCommand
                     : carnet.GetType(i)];
    for (auto [kind, count] : counts)
        txt.Print("  %s %6d", PadRight(KindLabel(kind), 14).c_str(), count);

    txt.Print("\nStations :");
    for (int i = carnet.Find(kKindStation, ""); i >= 0; i = carnet.Find(kKindStation, "", i + 1)) {
        int references = 0, measures = 0;
        for (int j = i + 1; j < carnet.GetSize() && carnet.GetType(j) != kKindStation; ++j) {
            references += carnet.GetType(j) == kKindReference;
            measures += carnet.GetType(j) == kKindMesure;
        }
        txt.Print("  %-12s HI = %s  V0 = %s  %d référence(s), %d mesure(s)",
                  carnet.StationDesignation(i).c_str(), Value(carnet.hiAt(i), CStation::DeciZ()).c_str(),
                  Value(carnet.v0At(i), CStation::DeciAng()).c_str(), references, measures);
    }

    txt.Print("\nPoints :");
    for (int i = carnet.Find(kKindPoint, ""); i >= 0; i = carnet.Find(kKindPoint, "", i + 1))
        txt.Print("  %-10s X = %14s  Y = %14s  Z = %10s", carnet.matAt(i).c_str(),
                  Value(carnet.xAt(i), CPointGen::DeciXY()).c_str(),
                  Value(carnet.yAt(i), CPointGen::DeciXY()).c_str(),
                  Value(carnet.zAt(i), CPointGen::DeciZ()).c_str());
}

} // namespace

int main(int argc, char** argv) {
    if (argc < 2 || argc > 3) {
        std::fprintf(stderr,
                     "Usage : pyralis GEOBASE.geo [COPIE.geo]\n"
                     "Montre le contenu de la GéoBase et, si une copie est demandée, l'y enregistre.\n");
        return 2;
    }
    ui::FrontEnd& frontEnd = ui::ApplicationFrontEnd();
    CPyrTxtWnd txt(frontEnd);
    CCarnet carnet;
    if (!carnet.Load(&txt, argv[1], {}, 0, &frontEnd)) return 1;
    txt.Print("GéoBase : %s", argv[1]);
    ShowContents(txt, carnet);
    if (argc == 3) {
        if (!carnet.Save(argv[2], &frontEnd, false)) return 1;
        txt.Print("\nGéoBase enregistrée dans <%s>.", argv[2]);
    }
    return 0;
}
