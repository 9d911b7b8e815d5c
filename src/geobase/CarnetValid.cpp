// Checking the elements that come from outside (field books, the editor) before they enter a GéoBase,
// and turning elements into comments and back.
#include "core/Angles.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "geobase/Carnet.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/GeoFile.h"
#include "geobase/Matricule.h"
#include "ui/PyrTxtWnd.h"

#include <cctype>
#include <cmath>

namespace pyr {

namespace {

std::string Shown(double value) {
    return FormatShortest(value);
}

bool Finite(double value) {
    return std::isfinite(value);
}

// The normalised identifier of an element, written back into it.
const std::string& NormalisedMat(CElement& element) {
    std::string mat = element.mat();
    FormMat(mat);
    element.setMat(std::move(mat));
    return element.mat();
}

// Checks what reference and measured sightings share; the reason of a refusal goes to the window.
bool CheckSighting(CPyrTxtWnd* txt, CVisee& sighting, bool hasStation) {
    const std::string& mat = NormalisedMat(sighting);
    const char* name = mat.c_str();
    if (mat.empty()) {
        if (txt) txt->Print("%s", msg::kSightingNoName);
        return false;
    }
    if (!hasStation) {
        if (txt) txt->Print(msg::kSightingNoStation, name);
        return false;
    }
    if (IsUndefined(sighting.ah()) && IsUndefined(sighting.av()) && IsUndefined(sighting.di())) {
        if (txt) txt->Print(msg::kSightingEmpty, name);
        return false;
    }
    if (IsKnown(sighting.ah())) {
        if (!Finite(sighting.ah())) {
            if (txt) txt->Print(msg::kSightingBadAH, name, Shown(sighting.ah()).c_str());
            return false;
        }
        sighting.setAH(WrapGrads(sighting.ah()));
    }
    if (IsKnown(sighting.av()) &&
        !(Finite(sighting.av()) && sighting.av() >= 0.0 && sighting.av() <= 400.0)) {
        if (txt) txt->Print(msg::kSightingBadAV, name, Shown(sighting.av()).c_str());
        return false;
    }
    if (IsKnown(sighting.di()) && !(Finite(sighting.di()) && sighting.di() >= 0.0)) {
        if (txt) txt->Print(msg::kSightingBadDI, name, Shown(sighting.di()).c_str());
        return false;
    }
    if (IsKnown(sighting.hp()) && !Finite(sighting.hp())) {
        if (txt) txt->Print(msg::kSightingBadHP, name, Shown(sighting.hp()).c_str());
        return false;
    }
    return true;
}

} // namespace

void CCarnet::Keep(CPyrTxtWnd* txt, std::unique_ptr<CElement> element, int kind, bool report) {
    const CElement& kept = *element;
    AddChecked(std::move(element), kind);
    if (report && txt) {
        std::string format(AddedReport(kind));
        txt->Print(format.c_str(), kept.mat().c_str());
    }
}

CStation* CCarnet::validStation(CPyrTxtWnd* txt, std::unique_ptr<CStation> station, bool report) {
    if (!station) return nullptr;
    const std::string& mat = NormalisedMat(*station);
    if (mat.empty()) {
        if (txt) txt->Print("%s", msg::kStationNoName);
        return nullptr;
    }
    if (IsKnown(station->hi()) && !Finite(station->hi())) {
        if (txt) txt->Print(msg::kStationBadHI, mat.c_str(), Shown(station->hi()).c_str());
        return nullptr;
    }
    if (IsKnown(station->v0())) {
        if (!Finite(station->v0())) {
            if (txt) txt->Print(msg::kStationBadV0, mat.c_str(), Shown(station->v0()).c_str());
            return nullptr;
        }
        // A V0 counts as known when it is >= 0: a negative one from a field book means "not oriented".
        station->setV0(station->v0() < 0.0 ? kUndefined : WrapGrads(station->v0()));
    }
    CStation* kept = station.get();
    Keep(txt, std::move(station), kKindStation, report);
    return kept;
}

CReference* CCarnet::validReference(CPyrTxtWnd* txt, std::unique_ptr<CReference> sighting, bool report) {
    if (!sighting || !CheckSighting(txt, *sighting, HasStation())) return nullptr;
    CReference* kept = sighting.get();
    Keep(txt, std::move(sighting), kKindReference, report);
    return kept;
}

CMesure* CCarnet::validMesure(CPyrTxtWnd* txt, std::unique_ptr<CMesure> sighting, bool report) {
    if (!sighting || !CheckSighting(txt, *sighting, HasStation())) return nullptr;
    CMesure* kept = sighting.get();
    Keep(txt, std::move(sighting), kKindMesure, report);
    return kept;
}

CPointGen* CCarnet::validPoint(CPyrTxtWnd* txt, std::unique_ptr<CPointGen> point, bool report) {
    if (!point) return nullptr;
    const std::string& mat = NormalisedMat(*point);
    const char* name = mat.c_str();
    const char* reason = nullptr;
    if (mat.empty())
        reason = msg::kPointNoName;
    else if ((IsKnown(point->x()) && !Finite(point->x())) || (IsKnown(point->y()) && !Finite(point->y())) ||
             (IsKnown(point->z()) && !Finite(point->z())))
        reason = msg::kPointBadValue;
    else if (IsKnown(point->x()) != IsKnown(point->y()))
        reason = msg::kPointHalfXY;
    else if (!point->isOk())
        reason = msg::kPointEmpty;
    if (reason) {
        if (txt) txt->Print(reason, name);
        return nullptr;
    }
    CPointGen* kept = point.get();
    Keep(txt, std::move(point), kKindPoint, report);
    return kept;
}

bool CCarnet::validComment(std::string_view line, std::string& label, std::string& value) {
    size_t equal = line.find('=');
    if (equal == std::string_view::npos) return false;
    label = std::string(Trimmed(line.substr(0, equal)));
    value = std::string(Trimmed(line.substr(equal + 1)));
    return true;
}

CComment* CCarnet::validComment(int labelWidth, std::string_view label, std::string_view value) {
    std::string text = PadRight(label, labelWidth);
    text += " = ";
    text += value;
    auto comment = std::make_unique<CComment>(std::move(text));
    CComment* kept = comment.get();
    AddChecked(std::move(comment), kKindComment);
    return kept;
}

// ---------------------------------------------------------------- disabling and enabling

bool CCarnet::changeObjectIntoComment(CPyrTxtWnd* txt, int index) {
    int kind = GetType(index);
    if (kind == 0) return false;
    if (kind == kKindComment) {
        if (txt) txt->Print(msg::kAlreadyComment, index + 1);
        return false;
    }
    // The comment keeps the element's whole line, so that it can be enabled again exactly.
    std::string mat = matAt(index);
    auto comment = std::make_unique<CComment>(ElementLine(*GetAt(index), kind));
    comment->m_inStore = true;
    m_elements[static_cast<size_t>(index)] = std::move(comment);
    m_kinds[static_cast<size_t>(index)] = kKindComment;
    Changed();
    if (txt) txt->Print(msg::kDisabled, index + 1, std::string(KindLabel(kind)).c_str(), mat.c_str());
    return true;
}

bool CCarnet::changeCommentIntoObject(CPyrTxtWnd* txt, int index) {
    int kind = GetType(index);
    if (kind == 0) return false;
    if (kind != kKindComment) {
        if (txt) txt->Print(msg::kNotAComment, index + 1);
        return false;
    }
    int parsedKind = 0;
    std::string error;
    auto element =
        ParseElementLine(static_cast<const CComment*>(GetAt(index))->text(), parsedKind, error, false);
    if (!element) {
        if (txt) txt->Print(msg::kNotAnElementComment, index + 1, error.c_str());
        return false;
    }
    std::string mat = element->mat();
    element->m_inStore = true;
    m_elements[static_cast<size_t>(index)] = std::move(element);
    m_kinds[static_cast<size_t>(index)] = parsedKind;
    Changed();
    if (txt) txt->Print(msg::kEnabled, index + 1, std::string(KindLabel(parsedKind)).c_str(), mat.c_str());
    return true;
}

} // namespace pyr
