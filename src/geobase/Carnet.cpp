#include "geobase/Carnet.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/Matricule.h"
#include "geobase/Selection.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <algorithm>
#include <cctype>
#include <cmath>

namespace pyr {

// ---------------------------------------------------------------- construction

CCarnet::CCarnet() = default;
CCarnet::~CCarnet() = default;

CCarnet::CCarnet(const CCarnet& other)
    : m_kinds(other.m_kinds), m_path(other.m_path), m_configuration(other.m_configuration),
      m_knownPath(other.m_knownPath), m_knownForeign(other.m_knownForeign) {
    m_elements.reserve(other.m_elements.size());
    for (const auto& element : other.m_elements) {
        m_elements.push_back(element->Clone());
        m_elements.back()->m_inStore = true;
    }
}

CCarnet& CCarnet::operator=(const CCarnet& other) {
    if (this != &other) {
        CCarnet copy(other);
        *this = std::move(copy);
    }
    return *this;
}

CCarnet::CCarnet(CCarnet&& other) noexcept
    : m_elements(std::move(other.m_elements)), m_kinds(std::move(other.m_kinds)),
      m_path(std::move(other.m_path)), m_configuration(std::move(other.m_configuration)),
      m_knownPath(std::move(other.m_knownPath)), m_knownForeign(other.m_knownForeign) {
    other.m_elements.clear();
    other.m_kinds.clear();
    other.Changed();
}

CCarnet& CCarnet::operator=(CCarnet&& other) noexcept {
    if (this != &other) {
        Changed();
        other.Changed();
        m_elements = std::move(other.m_elements);
        m_kinds = std::move(other.m_kinds);
        m_path = std::move(other.m_path);
        m_configuration = std::move(other.m_configuration);
        m_knownPath = std::move(other.m_knownPath);
        m_knownForeign = other.m_knownForeign;
        other.m_elements.clear();
        other.m_kinds.clear();
    }
    return *this;
}

// ---------------------------------------------------------------- the two arrays

const CElement* CCarnet::GetAt(int index) const {
    return IsValidIndex(index) ? m_elements[static_cast<size_t>(index)].get() : nullptr;
}

CElement* CCarnet::GetAt(int index) {
    return IsValidIndex(index) ? m_elements[static_cast<size_t>(index)].get() : nullptr;
}

int CCarnet::GetType(int index) const {
    return IsValidIndex(index) ? m_kinds[static_cast<size_t>(index)] : 0;
}

void CCarnet::AddChecked(std::unique_ptr<CElement> element, int kind) {
    element->m_inStore = true;
    m_elements.push_back(std::move(element));
    m_kinds.push_back(kind);
    m_index.Appended(m_elements.size(), CElement::IdentifierChanges(), *m_elements.back(), kind);
}

int CCarnet::Add(std::unique_ptr<CElement> element, int kind) {
    if (!element || !ElementFitsKind(*element, kind)) return -1;
    AddChecked(std::move(element), kind);
    return GetSize() - 1;
}

int CCarnet::InsertAt(int index, std::unique_ptr<CElement> element, int kind) {
    if (!element || !ElementFitsKind(*element, kind)) return -1;
    index = std::clamp(index, 0, GetSize());
    element->m_inStore = true;
    m_elements.insert(m_elements.begin() + index, std::move(element));
    m_kinds.insert(m_kinds.begin() + index, kind);
    m_index.Inserted(m_elements.size(), CElement::IdentifierChanges(), index,
                     *m_elements[static_cast<size_t>(index)], kind);
    m_noStationBefore = 0;
    return index;
}

void CCarnet::removeElement(int index) {
    RemoveRange(index, index + 1);
}

std::unique_ptr<CElement> CCarnet::TakeAt(int index, int& kind) {
    if (!IsValidIndex(index)) return nullptr;
    const auto at = static_cast<std::size_t>(index);
    std::unique_ptr<CElement> element = std::move(m_elements[at]);
    element->m_inStore = false;
    kind = m_kinds[at];
    m_elements.erase(m_elements.begin() + index);
    m_kinds.erase(m_kinds.begin() + index);
    m_index.Removed(m_elements.size(), CElement::IdentifierChanges(), index, kind);
    m_noStationBefore = 0;
    return element;
}

std::vector<CCarnet::Taken> CCarnet::TakeMany(const std::vector<int>& indices) {
    std::vector<Taken> taken;
    taken.reserve(indices.size());
    std::size_t kept = 0;
    std::size_t next = 0; // the next index to take
    for (std::size_t i = 0; i < m_elements.size(); ++i) {
        if (next < indices.size() && static_cast<std::size_t>(indices[next]) == i) {
            m_elements[i]->m_inStore = false;
            taken.push_back({indices[next++], m_kinds[i], std::move(m_elements[i])});
            continue;
        }
        if (kept != i) {
            m_elements[kept] = std::move(m_elements[i]);
            m_kinds[kept] = m_kinds[i];
        }
        ++kept;
    }
    m_elements.resize(kept);
    m_kinds.resize(kept);
    Changed();
    return taken;
}

bool CCarnet::PutBackMany(std::vector<Taken>& taken) {
    const std::size_t total = m_elements.size() + taken.size();
    for (std::size_t k = 0; k < taken.size(); ++k)
        if (!taken[k].element || static_cast<std::size_t>(taken[k].index) >= total ||
            (k > 0 && taken[k].index <= taken[k - 1].index))
            return false;
    std::vector<std::unique_ptr<CElement>> elements(total);
    std::vector<int> kinds(total);
    std::size_t from = 0, next = 0;
    for (std::size_t i = 0; i < total; ++i) {
        if (next < taken.size() && static_cast<std::size_t>(taken[next].index) == i) {
            taken[next].element->m_inStore = true;
            elements[i] = std::move(taken[next].element);
            kinds[i] = taken[next++].kind;
        } else {
            elements[i] = std::move(m_elements[from]);
            kinds[i] = m_kinds[from++];
        }
    }
    m_elements = std::move(elements);
    m_kinds = std::move(kinds);
    taken.clear();
    Changed();
    return true;
}

void CCarnet::RemoveRange(int first, int last) {
    first = std::max(first, 0);
    last = std::min(last, GetSize());
    if (first >= last) return;
    Changed();
    m_elements.erase(m_elements.begin() + first, m_elements.begin() + last);
    m_kinds.erase(m_kinds.begin() + first, m_kinds.begin() + last);
}

void CCarnet::RemoveAll() {
    Changed();
    m_elements.clear();
    m_kinds.clear();
}

void CCarnet::Append(CCarnet&& other) {
    if (&other == this) return;
    m_elements.reserve(m_elements.size() + other.m_elements.size());
    m_kinds.reserve(m_kinds.size() + other.m_kinds.size());
    for (size_t i = 0; i < other.m_elements.size(); ++i)
        AddChecked(std::move(other.m_elements[i]), other.m_kinds[i]);
    other.RemoveAll();
}

bool CCarnet::SetKindAt(int index, int kind) {
    int current = GetType(index);
    if (current == 0) return false;
    if (current == kind) return true;
    if (IsCommandKind(current) && IsCommandKind(kind)) {
        m_kinds[static_cast<size_t>(index)] = kind;
        Changed();
        return true;
    }
    auto copy = copyElement(index, kind);
    if (!copy) return false;
    copy->m_inStore = true;
    m_elements[static_cast<size_t>(index)] = std::move(copy);
    m_kinds[static_cast<size_t>(index)] = kind;
    Changed();
    return true;
}

std::unique_ptr<CElement> CCarnet::copyElement(int index, int kind) const {
    const CElement* element = GetAt(index);
    if (!element) return nullptr;
    int current = GetType(index);
    if (kind == -1 || kind == current || (IsCommandKind(current) && IsCommandKind(kind)))
        return element->Clone();
    if (IsSightingKind(current) && IsSightingKind(kind)) {
        const auto& sighting = static_cast<const CVisee&>(*element);
        if (kind == kKindReference) return std::make_unique<CReference>(sighting);
        return std::make_unique<CMesure>(sighting);
    }
    if (IsLevellingKind(current) && IsLevellingKind(kind)) {
        const auto& reading = static_cast<const CLecture&>(*element);
        if (kind == kKindLectAR) return std::make_unique<CLectAR>(reading);
        return std::make_unique<CLectAV>(reading);
    }
    return nullptr;
}

bool CCarnet::ExchangeAt(int index, std::unique_ptr<CElement>& element) {
    if (!IsValidIndex(index) || !element || !ElementFitsKind(*element, GetType(index))) return false;
    std::unique_ptr<CElement>& slot = m_elements[static_cast<size_t>(index)];
    slot->m_inStore = false;
    element->m_inStore = true;
    slot.swap(element);
    // The index views the identifiers in the elements.
    m_index.Exchanged(m_elements.size(), CElement::IdentifierChanges(), index, *element, *slot);
    m_noStationBefore = 0;
    return true;
}

// ---------------------------------------------------------------- accessors by index
// The kind array tells the class of each element: Add refuses an element that does not fit its kind.

std::string CCarnet::matAt(int index) const {
    const CElement* element = GetAt(index);
    return element ? element->mat() : std::string();
}

std::string CCarnet::cmdAt(int index) const {
    if (!IsCommandKind(GetType(index))) return {};
    return static_cast<const CCommande*>(GetAt(index))->word();
}

std::string CCarnet::symAt(int index) const {
    const CElement* element = GetAt(index);
    return element ? element->sym() : std::string();
}

std::string CCarnet::parAt(int index) const {
    const CElement* element = GetAt(index);
    return element ? element->par() : std::string();
}

double CCarnet::xAt(int index) const {
    return GetType(index) == kKindPoint ? static_cast<const CPointGen*>(GetAt(index))->x() : kUndefined;
}

double CCarnet::yAt(int index) const {
    return GetType(index) == kKindPoint ? static_cast<const CPointGen*>(GetAt(index))->y() : kUndefined;
}

double CCarnet::zAt(int index) const {
    return GetType(index) == kKindPoint ? static_cast<const CPointGen*>(GetAt(index))->z() : kUndefined;
}

double CCarnet::ahAt(int index) const {
    return IsSightingKind(GetType(index)) ? static_cast<const CVisee*>(GetAt(index))->ah() : kUndefined;
}

double CCarnet::avAt(int index) const {
    return IsSightingKind(GetType(index)) ? static_cast<const CVisee*>(GetAt(index))->av() : kUndefined;
}

double CCarnet::diAt(int index) const {
    int kind = GetType(index);
    if (IsSightingKind(kind)) return static_cast<const CVisee*>(GetAt(index))->di();
    if (IsLevellingKind(kind)) return static_cast<const CLecture*>(GetAt(index))->dist();
    return kUndefined;
}

double CCarnet::dhAt(int index) const {
    int kind = GetType(index);
    if (IsSightingKind(kind)) return static_cast<const CVisee*>(GetAt(index))->dh();
    if (IsLevellingKind(kind)) return static_cast<const CLecture*>(GetAt(index))->dist();
    return kUndefined;
}

double CCarnet::hiAt(int index) const {
    return GetType(index) == kKindStation ? static_cast<const CStation*>(GetAt(index))->hi() : kUndefined;
}

double CCarnet::hpAt(int index) const {
    return IsSightingKind(GetType(index)) ? static_cast<const CVisee*>(GetAt(index))->hp() : kUndefined;
}

double CCarnet::v0At(int index) const {
    return GetType(index) == kKindStation ? static_cast<const CStation*>(GetAt(index))->v0() : kUndefined;
}

double CCarnet::lmAt(int index) const {
    return IsLevellingKind(GetType(index)) ? static_cast<const CLecture*>(GetAt(index))->lm() : kUndefined;
}

double CCarnet::zFor(std::string_view mat) const {
    double z = kUndefined;
    hasZ(mat, z);
    return z;
}

double CCarnet::zFor(int index) const {
    const CElement* element = GetAt(index);
    return element ? zFor(element->mat()) : kUndefined;
}

// ---------------------------------------------------------------- look-ups

const CarnetIndex& CCarnet::Index() const {
    if (!m_index.IsValid(m_elements.size(), CElement::IdentifierChanges()))
        m_index.Build(m_elements, m_kinds, CElement::IdentifierChanges());
    return m_index;
}

int CCarnet::Find(int kind, std::string_view mat, int start, int direction) const {
    const int size = GetSize();
    const bool forward = direction >= 0;
    if (forward) {
        start = std::max(start, 0);
        if (start >= size) return -1;
    } else {
        start = std::min(start, size - 1);
        if (start < 0) return -1;
    }
    const CarnetIndex& index = Index();
    const std::vector<int>* list = nullptr;
    if (mat.empty()) {
        if (kind == 0) return start;
        list = &index.WithKind(kind);
    } else {
        list = index.WithMat(mat);
        if (!list) return -1;
    }
    auto matches = [&](int i) { return mat.empty() || kind == 0 || m_kinds[static_cast<size_t>(i)] == kind; };
    if (forward) {
        for (auto it = std::lower_bound(list->begin(), list->end(), start); it != list->end(); ++it)
            if (matches(*it)) return *it;
    } else {
        auto it = std::upper_bound(list->begin(), list->end(), start);
        while (it != list->begin()) {
            --it;
            if (matches(*it)) return *it;
        }
    }
    return -1;
}

int CCarnet::findMat(std::string_view mat) const {
    return mat.empty() ? -1 : Find(kKindPoint, mat, 0, 0);
}

const std::vector<int>& CCarnet::SameMat(int index) const {
    const CarnetIndex& names = Index();
    return names.WithNameRank(names.NameRankOf(index));
}

int CCarnet::NameRank(int index) const {
    return Index().NameRankOf(index);
}

int CCarnet::NameCount() const {
    return static_cast<int>(Index().NameCount());
}

int CCarnet::lastInd(std::string_view mat) const {
    return mat.empty() ? -1 : Find(kKindPoint, mat, GetSize() - 1, -1);
}

bool CCarnet::hasPnt(std::string_view mat) const {
    return findMat(mat) >= 0;
}

bool CCarnet::hasPnt(int index) const {
    return GetType(index) == kKindPoint;
}

bool CCarnet::hasXY(std::string_view mat) const {
    double x, y;
    return hasXY(mat, x, y);
}

bool CCarnet::hasXY(std::string_view mat, double& x, double& y) const {
    for (int i = findMat(mat); i >= 0; i = Find(kKindPoint, mat, i + 1, 0)) {
        const auto* point = static_cast<const CPointGen*>(GetAt(i));
        if (point->hasXY()) {
            x = point->x();
            y = point->y();
            return true;
        }
    }
    return false;
}

bool CCarnet::hasXY(int index) const {
    return GetType(index) == kKindPoint && static_cast<const CPointGen*>(GetAt(index))->hasXY();
}

bool CCarnet::hasZ(std::string_view mat) const {
    double z;
    return hasZ(mat, z);
}

bool CCarnet::hasZ(std::string_view mat, double& z) const {
    for (int i = findMat(mat); i >= 0; i = Find(kKindPoint, mat, i + 1, 0)) {
        const auto* point = static_cast<const CPointGen*>(GetAt(i));
        if (point->hasZ()) {
            z = point->z();
            return true;
        }
    }
    return false;
}

bool CCarnet::hasZ(int index) const {
    return GetType(index) == kKindPoint && static_cast<const CPointGen*>(GetAt(index))->hasZ();
}

// ---------------------------------------------------------------- stations and reprises

int CCarnet::findStaRep(std::string_view name, int reprise) const {
    if (name.empty() || reprise < 1) return -1;
    const std::vector<int>* list = Index().WithMat(name);
    if (!list) return -1;
    int rank = 0;
    for (int i : *list)
        if (m_kinds[static_cast<size_t>(i)] == kKindStation && ++rank == reprise) return i;
    return -1;
}

bool CCarnet::extrStaRep(std::string_view text, std::string& name, int& reprise) {
    text = Trimmed(text);
    reprise = 1;
    if (!text.empty() && text.back() == ')') {
        size_t open = text.rfind('(');
        if (open == std::string_view::npos) return false;
        long long number = 0;
        if (!ParseInt(text.substr(open + 1, text.size() - open - 2), number) || number < 1 ||
            number > 1000000)
            return false;
        reprise = static_cast<int>(number);
        text = Trimmed(text.substr(0, open));
    }
    name = std::string(text);
    return !name.empty();
}

int CCarnet::RepriseAt(int stationIndex) const {
    if (GetType(stationIndex) != kKindStation) return 0;
    // The set-ups on the same point up to this one, among the elements of its identifier reached through
    // the station's own rank, its name never read nor hashed.
    int rank = 0;
    for (int i : SameMat(stationIndex)) {
        if (m_kinds[static_cast<size_t>(i)] == kKindStation) ++rank;
        if (i == stationIndex) return rank;
    }
    return 1; // a station without a name is its own only reprise
}

std::string CCarnet::StationDesignation(int stationIndex) const {
    return matAt(stationIndex) + "(" + std::to_string(RepriseAt(stationIndex)) + ")";
}

int CCarnet::findRepAt(int index, std::string& name) const {
    if (!IsValidIndex(index)) return -1;
    const std::vector<int>& stations = Index().WithKind(kKindStation);
    auto it = std::upper_bound(stations.begin(), stations.end(), index);
    if (it == stations.begin()) return -1;
    int station = *std::prev(it);
    name = matAt(station);
    return station;
}

int CCarnet::CountStations() const {
    return static_cast<int>(Index().WithKind(kKindStation).size());
}

bool CCarnet::HasStation() const {
    if (GetType(m_stationSeen) == kKindStation) return true;
    const auto from =
        m_kinds.begin() + static_cast<std::ptrdiff_t>(std::min(m_noStationBefore, m_kinds.size()));
    const auto found = std::find(from, m_kinds.end(), kKindStation);
    if (found == m_kinds.end()) {
        m_noStationBefore = m_kinds.size();
        return false;
    }
    m_stationSeen = static_cast<int>(found - m_kinds.begin());
    return true;
}

const CAppareil* CCarnet::findAppAt(int index) const {
    if (!IsValidIndex(index)) return nullptr;
    const std::vector<int>& instruments = Index().WithKind(kKindAppareil);
    auto it = std::upper_bound(instruments.begin(), instruments.end(), index);
    if (it == instruments.begin()) return nullptr;
    return static_cast<const CAppareil*>(GetAt(*std::prev(it)));
}

double CCarnet::FindEccentric(std::string_view word, int index, int limit) const {
    for (int i = std::min(index, GetSize()) - 1; i > limit && i >= 0; --i) {
        int kind = m_kinds[static_cast<size_t>(i)];
        if (IsObservationOrPointKind(kind)) break;
        if (kind == kKindExcentrement) {
            const auto* command = static_cast<const CCommande*>(GetAt(i));
            if (EqualIgnoringCase(command->word(), word)) return command->value();
        }
    }
    return 0.0;
}

double CCarnet::findER(int index, int limit) const {
    return FindEccentric(kExcentRad, index, limit);
}
double CCarnet::findET(int index, int limit) const {
    return FindEccentric(kExcentTan, index, limit);
}
double CCarnet::findEV(int index, int limit) const {
    return FindEccentric(kExcentVer, index, limit);
}

bool CCarnet::isObsAltiAt(int sighting, int station) const {
    if (!IsSightingKind(GetType(sighting)) || GetType(station) != kKindStation) return false;
    const auto* s = static_cast<const CVisee*>(GetAt(sighting));
    return IsKnown(s->av()) && IsKnown(s->di()) && s->di() > 0 && IsKnown(s->hp()) && IsKnown(hiAt(station));
}

// ---------------------------------------------------------------- identifiers and selections

void CCarnet::formMat(std::string& mat) {
    FormMat(mat);
}

void CCarnet::formMat(std::string& mat, std::string_view prefix, long long number, int minDigits) {
    mat = FormMat(prefix, number, minDigits);
}

bool CCarnet::extrMat(std::string_view mat, std::string& prefix, long long& number) {
    return ExtrMat(mat, prefix, number);
}

std::string CCarnet::nextMat(std::string_view mat) const {
    const CarnetIndex& index = Index();
    return NextMat(mat, [&index](std::string_view candidate) { return index.WithMat(candidate) != nullptr; });
}

std::string CCarnet::nextMat(long long number) const {
    return nextMat(std::to_string(number));
}

bool CCarnet::DDX_Mat(ui::FrontEnd* parent, bool saveAndValidate, std::string& fieldText,
                      std::string& value) {
    return pyr::DDX_Mat(parent, saveAndValidate, fieldText, value);
}

bool CCarnet::DDV_Mat(ui::FrontEnd* parent, std::string_view mat) {
    return pyr::DDV_Mat(parent, mat);
}

bool CCarnet::IsValidSelString(std::string_view text) {
    return pyr::IsValidSelString(text);
}

long long CCarnet::GetSelStringCount(std::string_view text) {
    return pyr::GetSelStringCount(text);
}

bool CCarnet::IsPointInSel(std::string_view mat, std::string_view text) {
    return pyr::IsPointInSel(mat, text);
}

// ---------------------------------------------------------------- decimals

double CCarnet::formatXY(double value) {
    return RoundToDecimals(value, s_deciXY);
}
double CCarnet::formatZ(double value) {
    return RoundToDecimals(value, s_deciZ);
}
double CCarnet::formatAng(double value) {
    return RoundToDecimals(value, s_deciAng);
}

} // namespace pyr
