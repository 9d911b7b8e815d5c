#include "editor/Renumbering.h"

#include "core/Strings.h"
#include "geobase/Carnet.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/Matricule.h"
#include "geobase/Selection.h"

#include <algorithm>
#include <unordered_map>

namespace pyr {

namespace {

// The kinds whose identifier is a point of the ground: stations, sightings, levelling readings, points,
// and the commands that name a point (a command without one has no identifier at all).
bool BearsPoint(int kind) {
    return (kind >= kKindStation && kind <= kKindPoint) || IsCommandKind(kind);
}

// Refusals, written out up to a limit and counted beyond it.
class Refusals {
public:
    explicit Refusals(std::vector<std::string>& out) : m_out(out) {}
    void Add(std::string text) {
        if (static_cast<int>(m_out.size()) < kRenumberRefusalsListed)
            m_out.push_back(std::move(text));
        else
            ++m_more;
    }
    void Close() {
        if (m_more > 0) m_out.push_back(Sprintf(msg::kRenumberMoreRefusals, m_more));
    }
    bool Any() const { return !m_out.empty(); }

private:
    std::vector<std::string>& m_out;
    long long m_more = 0;
};

// The identifiers renamed: for each name rank of the store, the entry of `renamed` that gives its new
// identifier, -1 when it keeps its own.
struct Renaming {
    std::vector<int> entryOfRank;
    std::vector<RenamedIdentifier> renamed;
};

// The traverse with its designations of renamed stations changed, the reprise kept ("S1(2)" to
// "B1(2)"); null when none of them changes.
std::unique_ptr<CChemin>
RenamedTraverse(const CChemin& traverse,
                const std::unordered_map<std::string_view, std::string_view>& newNameOf) {
    std::vector<std::string> designations;
    bool changed = false;
    std::string name;
    int reprise = 0;
    for (const std::string& designation : traverse.stations()) {
        designations.push_back(designation);
        if (!CCarnet::extrStaRep(designation, name, reprise)) continue;
        const auto found = newNameOf.find(name);
        if (found == newNameOf.end()) continue;
        const bool withReprise = !Trimmed(designation).empty() && Trimmed(designation).back() == ')';
        designations.back() = std::string(found->second);
        if (withReprise) designations.back() += "(" + std::to_string(reprise) + ")";
        changed = true;
    }
    if (!changed) return nullptr;
    auto copy = std::make_unique<CChemin>(traverse.mat(), traverse.sym());
    copy->setPar(traverse.par());
    copy->setClosed(traverse.isClosed());
    for (std::string& designation : designations)
        copy->add(std::move(designation));
    return copy;
}

// Every element that the renaming changes, in GéoBase order: one pass over the store, the identifier
// of each element found by its rank, and a hash look-up per traverse designation.
ElementReplacements Replacements(const CCarnet& carnet, const Renaming& renaming) {
    ElementReplacements replacements;
    std::unordered_map<std::string_view, std::string_view> newNameOf;
    if (carnet.Find(kKindChemin, {}) >= 0) {
        newNameOf.reserve(renaming.renamed.size());
        for (const RenamedIdentifier& entry : renaming.renamed)
            newNameOf.emplace(entry.from, entry.to);
    }
    const int size = carnet.GetSize();
    for (int i = 0; i < size; ++i) {
        const int kind = carnet.GetType(i);
        if (BearsPoint(kind)) {
            const int rank = carnet.NameRank(i);
            if (rank < 0) continue;
            const int entry = renaming.entryOfRank[static_cast<std::size_t>(rank)];
            if (entry < 0) continue;
            std::unique_ptr<CElement> copy = carnet.GetAt(i)->Clone();
            copy->setMat(renaming.renamed[static_cast<std::size_t>(entry)].to);
            replacements.push_back({i, std::move(copy)});
        } else if (kind == kKindChemin && !newNameOf.empty()) {
            if (auto copy = RenamedTraverse(*carnet.As<CChemin>(i), newNameOf))
                replacements.push_back({i, std::move(copy)});
        }
    }
    return replacements;
}

// The new identifier of `id` in a renumbering, or a refusal; nothing for an identifier that a shift
// leaves as it is (no number).
struct NewIdentifier {
    std::string id;
    bool unnumbered = false;
};

bool AddWithin(long long number, long long offset, long long& sum) {
    if (offset > 0 && number > kMaxMatNumber - offset) return false;
    sum = number + offset;
    return sum >= 0 && sum <= kMaxMatNumber;
}

std::optional<NewIdentifier> NewIdentifierOf(std::string_view id, long long rankInOrder,
                                             const RenumberRequest& request, Refusals& refusals) {
    NewIdentifier result;
    long long number = 0;
    std::string_view prefix;
    int width = request.minDigits;
    if (request.mode == RenumberRequest::Mode::Shift) {
        const MatParts parts = SplitMat(FormMatView(id));
        if (parts.digits.empty() || parts.number < 0) {
            result.unnumbered = true;
            return result;
        }
        if (!AddWithin(parts.number, request.offset, number)) {
            refusals.Add(Sprintf(msg::kRenumberOutOfRange, std::string(id).c_str()));
            return std::nullopt;
        }
        prefix = request.newPrefix ? std::string_view(*request.newPrefix) : parts.prefix;
        width = std::max(width, static_cast<int>(parts.digits.size()));
    } else {
        if (!AddWithin(request.start, rankInOrder, number)) {
            refusals.Add(Sprintf(msg::kRenumberOutOfRange, std::string(id).c_str()));
            return std::nullopt;
        }
        if (request.newPrefix) prefix = *request.newPrefix;
    }
    result.id = FormMat(prefix, number, width);
    std::string why;
    if (!IsValidMat(result.id, &why)) {
        refusals.Add(Sprintf(msg::kRenumberBadNew, std::string(id).c_str(), result.id.c_str(), why.c_str()));
        return std::nullopt;
    }
    return result;
}

} // namespace

RenumberResult RenumberPoints(const CCarnet& carnet, const RenumberRequest& request) {
    RenumberResult result;
    std::optional<CSelection> selection;
    if (!request.selection.empty()) {
        selection = CSelection::Parse(request.selection);
        if (!selection) {
            result.refusals.emplace_back(msg::kNoSelection);
            return result;
        }
    }

    // The points in the order of their first element, and the first element of each, by name rank.
    const int names = carnet.NameCount();
    std::vector<int> firstOfRank(static_cast<std::size_t>(names), -1);
    std::vector<int> order;
    const int size = carnet.GetSize();
    for (int i = 0; i < size; ++i) {
        if (!BearsPoint(carnet.GetType(i))) continue;
        const int rank = carnet.NameRank(i);
        if (rank < 0 || firstOfRank[static_cast<std::size_t>(rank)] >= 0) continue;
        firstOfRank[static_cast<std::size_t>(rank)] = i;
        order.push_back(rank);
    }

    Renaming renaming;
    renaming.entryOfRank.assign(static_cast<std::size_t>(names), -1);
    Refusals refusals(result.refusals);
    long long taken = 0;
    for (int rank : order) {
        const std::string& id = carnet.GetAt(firstOfRank[static_cast<std::size_t>(rank)])->mat();
        if (selection && !selection->Contains(id)) continue;
        const std::optional<NewIdentifier> next = NewIdentifierOf(id, taken++, request, refusals);
        if (!next) continue;
        if (next->unnumbered) {
            result.unnumbered.push_back(id);
            continue;
        }
        if (next->id == id) continue;
        renaming.entryOfRank[static_cast<std::size_t>(rank)] = static_cast<int>(renaming.renamed.size());
        renaming.renamed.push_back({id, next->id});
    }

    // Two points sent to one identifier, or one sent onto a point that stays.
    std::unordered_map<std::string_view, std::size_t> entryOfNew;
    entryOfNew.reserve(renaming.renamed.size());
    for (std::size_t e = 0; e < renaming.renamed.size(); ++e) {
        const RenamedIdentifier& entry = renaming.renamed[e];
        const auto [found, inserted] = entryOfNew.emplace(entry.to, e);
        if (!inserted) {
            refusals.Add(Sprintf(msg::kRenumberSameNew, renaming.renamed[found->second].from.c_str(),
                                 entry.from.c_str(), entry.to.c_str()));
            continue;
        }
        const int holder = carnet.Find(0, entry.to);
        if (holder < 0) continue;
        const auto rank = static_cast<std::size_t>(carnet.NameRank(holder));
        if (firstOfRank[rank] >= 0 && renaming.entryOfRank[rank] < 0)
            refusals.Add(Sprintf(msg::kRenumberPointExists, entry.to.c_str()));
    }
    if (!refusals.Any() && renaming.renamed.empty()) refusals.Add(msg::kRenumberNothing);
    refusals.Close();
    if (!result.refusals.empty()) {
        result.unnumbered.clear();
        return result;
    }

    result.replacements = Replacements(carnet, renaming);
    result.renamed = std::move(renaming.renamed);
    return result;
}

RenumberResult RenameStation(const CCarnet& carnet, std::string_view oldName, std::string_view newName) {
    RenumberResult result;
    const std::string from(FormMatView(oldName));
    const std::string to(FormMatView(newName));
    std::string why;
    if (to.empty()) {
        result.refusals.emplace_back(msg::kMatMissing);
        return result;
    }
    if (!IsValidMat(to, &why)) {
        result.refusals.push_back(Sprintf(msg::kMatIncorrect, to.c_str(), why.c_str()));
        return result;
    }
    const int station = carnet.Find(kKindStation, from);
    if (from.empty() || station < 0) {
        result.refusals.push_back(Sprintf(msg::kRenameNoStation, from.c_str()));
        return result;
    }
    if (to == from) {
        result.refusals.push_back(Sprintf(msg::kRenameSameName, from.c_str()));
        return result;
    }
    if (carnet.Find(kKindStation, to) >= 0) {
        result.refusals.push_back(Sprintf(msg::kRenameStationExists, to.c_str()));
        return result;
    }
    if (carnet.findMat(to) >= 0) {
        result.refusals.push_back(Sprintf(msg::kRenamePointExists, to.c_str()));
        return result;
    }

    Renaming renaming;
    renaming.entryOfRank.assign(static_cast<std::size_t>(carnet.NameCount()), -1);
    renaming.entryOfRank[static_cast<std::size_t>(carnet.NameRank(station))] = 0;
    renaming.renamed.push_back({from, to});
    result.replacements = Replacements(carnet, renaming);
    result.renamed = std::move(renaming.renamed);
    return result;
}

} // namespace pyr
