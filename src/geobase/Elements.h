#pragma once

#include "core/Undefined.h"
#include "geobase/ElementPool.h"

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

// The elements of a GéoBase. Angles are in grads (400 to the circle), lengths in metres; a real field
// without a value holds kUndefined.
namespace pyr {

class CCarnet;

// What every element carries: the identifier (matricule) of its point or station, a code or symbol, and
// a free parameter string.
class CElement {
public:
    virtual ~CElement() = default;
    virtual std::unique_ptr<CElement> Clone() const = 0;

    // Elements come from the element pool; the virtual destructor hands the right size back.
    static void* operator new(std::size_t size) { return ElementPool::Allocate(size); }
    static void operator delete(void* memory, std::size_t size) noexcept { ElementPool::Free(memory, size); }

    const std::string& mat() const { return m_mat; }
    const std::string& sym() const { return m_more ? m_more->sym : NoText(); }
    const std::string& par() const { return m_more ? m_more->par : NoText(); }
    void setMat(std::string mat);
    void setSym(std::string sym);
    void setPar(std::string par);

    // Counts the changes of identifier of the elements that stand in a store, so that a store's index
    // knows it must be rebuilt even when an element was renamed through a pointer.
    static std::uint64_t IdentifierChanges() { return s_identifierChanges; }

protected:
    CElement() = default;
    explicit CElement(std::string mat, std::string sym = {}) : m_mat(std::move(mat)) {
        setSym(std::move(sym));
    }
    // A copy is not in a store, whatever the original.
    CElement(const CElement& other)
        : m_mat(other.m_mat), m_more(other.m_more ? new More(*other.m_more) : nullptr) {}
    CElement& operator=(const CElement& other) {
        setMat(other.m_mat);
        setSym(other.sym());
        setPar(other.par());
        return *this;
    }

private:
    friend class CCarnet;
    static const std::string& NoText();

    // The code and the parameters, which most sightings of a big job have not: kept apart, so that an
    // element without them is smaller by 56 bytes (a million sightings by 56 MB).
    struct More {
        std::string sym;
        std::string par;
    };
    std::string m_mat;
    std::unique_ptr<More> m_more;
    bool m_inStore = false;
    static inline std::uint64_t s_identifierChanges = 0;
};

// A comment line (kind 1000). A line that could not be read, or an element disabled by the editor,
// is kept as a comment holding its text, so that nothing is lost.
class CComment : public CElement {
public:
    explicit CComment(std::string text = {}) : m_text(std::move(text)) {}
    std::unique_ptr<CElement> Clone() const override { return std::make_unique<CComment>(*this); }

    const std::string& text() const { return m_text; }
    void setText(std::string text) { m_text = std::move(text); }

private:
    std::string m_text;
};

// An instrument set-up (kind 1001). A station name may occur several times in a GéoBase: each
// occurrence is a reprise, designated "%s(%d)" with its rank from 1.
class CStation : public CElement {
public:
    explicit CStation(std::string mat = {}, double hi = 0.0, double v0 = kUndefined, std::string sym = {})
        : CElement(std::move(mat), std::move(sym)), m_hi(hi), m_v0(v0) {}
    std::unique_ptr<CElement> Clone() const override { return std::make_unique<CStation>(*this); }

    double hi() const { return m_hi; } // instrument height (m)
    double v0() const { return m_v0; } // orientation (gr), known when >= 0
    void setHI(double hi) { m_hi = hi; }
    void setV0(double v0) { m_v0 = v0; }

    static int DeciZ() { return s_deciZ; }
    static int DeciAng() { return s_deciAng; }
    static void setDeciZ(int n) { s_deciZ = n; }
    static void setDeciAng(int n) { s_deciAng = n; }

private:
    double m_hi;
    double m_v0;
    static inline int s_deciZ = 3;
    static inline int s_deciAng = 5;
};

// What reference sightings (1002) and measured sightings (1003) share: the sighted point, the target
// height HP, the horizontal direction AH, the zenith angle AV and the slope distance DI.
class CVisee : public CElement {
public:
    double hp() const { return m_hp; }
    double ah() const { return m_ah; }
    double av() const { return m_av; }
    double di() const { return m_di; }
    void setHP(double hp) { m_hp = hp; }
    void setAH(double ah) { m_ah = ah; }
    void setAV(double av) { m_av = av; }
    void setDI(double di) { m_di = di; }
    // The horizontal distance DI × sin(AV); undefined without a zenith angle or a distance.
    double dh() const;

    static int DeciXY() { return s_deciXY; }
    static int DeciZ() { return s_deciZ; }
    static int DeciAng() { return s_deciAng; }
    static void setDeciXY(int n) { s_deciXY = n; }
    static void setDeciZ(int n) { s_deciZ = n; }
    static void setDeciAng(int n) { s_deciAng = n; }

protected:
    // A new sighting holds 0.0 in its four values; the short form gives AH only.
    CVisee(std::string mat, double hp, double ah, double av, double di, std::string sym)
        : CElement(std::move(mat), std::move(sym)), m_hp(hp), m_ah(ah), m_av(av), m_di(di) {}

private:
    double m_hp;
    double m_ah;
    double m_av;
    double m_di;
    static inline int s_deciXY = 4;
    static inline int s_deciZ = 3;
    static inline int s_deciAng = 5;
};

class CReference : public CVisee {
public:
    CReference() : CReference(std::string(), 0.0, 0.0, 0.0, 0.0) {}
    CReference(std::string mat, double hp, double ah, double av, double di, std::string sym = {})
        : CVisee(std::move(mat), hp, ah, av, di, std::move(sym)) {}
    CReference(std::string mat, double ah) : CReference(std::move(mat), 0.0, ah, 0.0, 0.0) {}
    explicit CReference(const CVisee& other) : CVisee(other) {}
    std::unique_ptr<CElement> Clone() const override { return std::make_unique<CReference>(*this); }
};

class CMesure : public CVisee {
public:
    CMesure() : CMesure(std::string(), 0.0, 0.0, 0.0, 0.0) {}
    CMesure(std::string mat, double hp, double ah, double av, double di, std::string sym = {})
        : CVisee(std::move(mat), hp, ah, av, di, std::move(sym)) {}
    CMesure(std::string mat, double ah) : CMesure(std::move(mat), 0.0, ah, 0.0, 0.0) {}
    explicit CMesure(const CVisee& other) : CVisee(other) {}
    std::unique_ptr<CElement> Clone() const override { return std::make_unique<CMesure>(*this); }
};

// What levelling back readings (1004) and fore readings (1005) share: the staff point, the reading
// on the staff and the distance to it.
class CLecture : public CElement {
public:
    double lm() const { return m_lm; }
    double dist() const { return m_dist; }
    void setLM(double lm) { m_lm = lm; }
    void setDist(double dist) { m_dist = dist; }

    static int DeciXY() { return s_deciXY; }
    static int DeciZ() { return s_deciZ; }
    static void setDeciXY(int n) { s_deciXY = n; }
    static void setDeciZ(int n) { s_deciZ = n; }

protected:
    CLecture(std::string mat, double lm, double dist, std::string sym)
        : CElement(std::move(mat), std::move(sym)), m_lm(lm), m_dist(dist) {}

private:
    double m_lm;
    double m_dist;
    static inline int s_deciXY = 4;
    static inline int s_deciZ = 3;
};

class CLectAR : public CLecture {
public:
    explicit CLectAR(std::string mat = {}, double lm = 0.0, double dist = kUndefined, std::string sym = {})
        : CLecture(std::move(mat), lm, dist, std::move(sym)) {}
    explicit CLectAR(const CLecture& other) : CLecture(other) {}
    std::unique_ptr<CElement> Clone() const override { return std::make_unique<CLectAR>(*this); }
};

class CLectAV : public CLecture {
public:
    explicit CLectAV(std::string mat = {}, double lm = 0.0, double dist = kUndefined, std::string sym = {})
        : CLecture(std::move(mat), lm, dist, std::move(sym)) {}
    explicit CLectAV(const CLecture& other) : CLecture(other) {}
    std::unique_ptr<CElement> Clone() const override { return std::make_unique<CLectAV>(*this); }
};

// A point with known coordinates (kind 1006): planimetry only, altimetry only, or both. X is the
// easting, Y the northing. Coordinates may be declared invariant: a computation asks before
// replacing them.
class CPointGen : public CElement {
public:
    CPointGen() : CElement() {}
    CPointGen(std::string mat, double x, double y, double z, std::string sym = {})
        : CElement(std::move(mat), std::move(sym)), m_x(x), m_y(y), m_z(z) {}
    CPointGen(std::string mat, double x, double y, std::string sym = {})
        : CPointGen(std::move(mat), x, y, kUndefined, std::move(sym)) {}
    CPointGen(std::string mat, double z, std::string sym = {})
        : CPointGen(std::move(mat), kUndefined, kUndefined, z, std::move(sym)) {}
    std::unique_ptr<CElement> Clone() const override { return std::make_unique<CPointGen>(*this); }

    double x() const { return m_x; }
    double y() const { return m_y; }
    double z() const { return m_z; }
    void setX(double x) { m_x = x; }
    void setY(double y) { m_y = y; }
    void setZ(double z) { m_z = z; }

    // Computed results, rounded to the decimals settings of the class; `invariant` also declares the
    // coordinates written invariant. False, and nothing written, when a value is not a finite number.
    bool setPt(double x, double y, double z, bool invariant = false);
    bool setPt(double x, double y, bool invariant = false);
    bool setPt(double z, bool invariant = false);

    bool invariantXY() const { return m_invariantXY; }
    bool invariantZ() const { return m_invariantZ; }
    void setInvariantXY(bool on) { m_invariantXY = on; }
    void setInvariantZ(bool on) { m_invariantZ = on; }

    bool hasXY() const { return IsKnown(m_x) && IsKnown(m_y); }
    bool hasZ() const { return IsKnown(m_z); }
    bool hasXYZ() const { return hasXY() && hasZ(); }
    bool is2D() const { return hasXY() && !hasZ(); }
    bool is3D() const { return hasXYZ(); }
    bool isOk() const { return hasXY() || hasZ(); } // holds at least a planimetry or an altitude

    static int DeciXY() { return s_deciXY; }
    static int DeciZ() { return s_deciZ; }
    static void setDeciXY(int n) { s_deciXY = n; }
    static void setDeciZ(int n) { s_deciZ = n; }
    // Whether listings and journals show Y before X, for every point.
    static bool SwapXY() { return s_swapXY; }
    static void setSwapXY(bool swap) { s_swapXY = swap; }

private:
    double m_x = kUndefined;
    double m_y = kUndefined;
    double m_z = kUndefined;
    bool m_invariantXY = false;
    bool m_invariantZ = false;
    static inline int s_deciXY = 4;
    static inline int s_deciZ = 3;
    static inline bool s_swapXY = false;
};

// A traverse (kind 1007): its name (the identifier), the ordered list of its stations, designated
// "%s(%d)" when a station has several reprises, and whether it is closed.
class CChemin : public CElement {
public:
    explicit CChemin(std::string name = {}, std::string sym = {})
        : CElement(std::move(name), std::move(sym)) {}
    std::unique_ptr<CElement> Clone() const override { return std::make_unique<CChemin>(*this); }

    const std::vector<std::string>& stations() const { return m_stations; }
    void add(std::string station) { m_stations.push_back(std::move(station)); }
    // Appends the station at that index of the store, with its reprise ("S1(2)"); false when the
    // element there is not a station.
    bool add(int index, const CCarnet& store);
    bool isClosed() const { return m_closed; }
    void setClosed(bool closed) { m_closed = closed; }

private:
    std::vector<std::string> m_stations;
    bool m_closed = false;
};

// An instrument (kind 1008) and its constants; the stations and sightings that follow use it.
class CAppareil : public CElement {
public:
    explicit CAppareil(std::string name = {}, double collVerticale = 0.0, double constPrisme = 0.0)
        : CElement(std::move(name)), m_collVerticale(collVerticale), m_constPrisme(constPrisme) {}
    std::unique_ptr<CElement> Clone() const override { return std::make_unique<CAppareil>(*this); }

    double collVerticale() const { return m_collVerticale; } // vertical collimation, added to AV (gr)
    double constPrisme() const { return m_constPrisme; }     // prism constant, added to DI (m)
    double sigmaAh() const { return m_sigmaAh; }             // precision of directions (gr)
    double sigmaAv() const { return m_sigmaAv; }             // precision of zenith angles (gr)
    double sigmaDi() const { return m_sigmaDi; }             // constant part of the distance precision (m)
    double sigmaPpm() const { return m_sigmaPpm; }           // proportional part (mm/km)
    void setCollVerticale(double v) { m_collVerticale = v; }
    void setConstPrisme(double v) { m_constPrisme = v; }
    void setSigmaAh(double v) { m_sigmaAh = v; }
    void setSigmaAv(double v) { m_sigmaAv = v; }
    void setSigmaDi(double v) { m_sigmaDi = v; }
    void setSigmaPpm(double v) { m_sigmaPpm = v; }

    static int DeciXY() { return s_deciXY; }
    static int DeciAng() { return s_deciAng; }
    static void setDeciXY(int n) { s_deciXY = n; }
    static void setDeciAng(int n) { s_deciAng = n; }

private:
    double m_collVerticale;
    double m_constPrisme;
    double m_sigmaAh = 0.0;
    double m_sigmaAv = 0.0;
    double m_sigmaDi = 0.0;
    double m_sigmaPpm = 0.0;
    static inline int s_deciXY = 4;
    static inline int s_deciAng = 5;
};

// A codification command (kinds 1009 to 1065): its word ("ExcentRad", "Sym_2Pts" ...) and its
// parameters (the parameter string). The eccentric offsets (1010) carry their offset in metres as
// the first number of their parameters.
class CCommande : public CElement {
public:
    explicit CCommande(std::string word = {}, std::string parameters = {}, std::string mat = {})
        : CElement(std::move(mat)), m_word(std::move(word)) {
        setPar(std::move(parameters));
    }
    std::unique_ptr<CElement> Clone() const override { return std::make_unique<CCommande>(*this); }

    const std::string& word() const { return m_word; }
    void setWord(std::string word) { m_word = std::move(word); }
    // The first number of the parameters; 0 when they hold none.
    double value() const;

private:
    std::string m_word;
};

// Whether an element object may stand under that kind code (a CMesure only under 1003, a CCommande
// under 1009 to 1065 ...).
bool ElementFitsKind(const CElement& element, int kind);

// Sets the decimals settings of every element class and of the store together.
void SetStoreDecimals(int deciXY, int deciZ, int deciAng);

} // namespace pyr
