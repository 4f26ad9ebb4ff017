#include "frame/entry.h"
#include "krnumer/anova.h"
#include "stat/anova.h"

using namespace krnumer;

int32_t Anova1Way_head(KrHandle y, KrHandle levels, const int32_t* k, double* ssBetween, double* msBetween, double* f,
                       double* p, double* ssWithin, double* msWithin, double* ssTotal, int32_t* err) {
    ByReference call(err);
    In<double> observations(call, y);
    In<int32_t> groups(call, levels);
    Result<double> between(call, ssBetween);
    Result<double> between_mean(call, msBetween);
    Result<double> ratio(call, f);
    Result<double> tail(call, p);
    Result<double> within(call, ssWithin);
    Result<double> within_mean(call, msWithin);
    Result<double> total(call, ssTotal);
    if (groups.size() != observations.size()) return call.Fail(kSizesDiffer);
    return call.Run([&] {
        OneWayAnova result;
        const int32_t status = AnalyseOneWay(observations.data(), groups.data(), observations.size(), *k, &result);
        if (status != kOk) return status;
        *between = result.ss_between;
        *between_mean = result.ms_between;
        *ratio = result.f;
        *tail = result.p;
        *within = result.ss_within;
        *within_mean = result.ms_within;
        *total = result.ss_total;
        return kOk;
    });
}

namespace {

// The table of an analysis as the caller's matrix of four columns.
static_assert(sizeof(AnovaRow) == 4 * sizeof(double));
AnovaRow* Rows(OutMatrix<double>& table) {
    return reinterpret_cast<AnovaRow*>(table.data());
}

}  // namespace

int32_t Anova2Way_head(KrHandle y, KrHandle levelsA, KrHandle levelsB, const int32_t* r, const int32_t* a,
                       const int32_t* b, KrHandle table, double* pA, double* pB, double* pAB, int32_t* err) {
    ByReference call(err);
    In<double> observations(call, y);
    In<int32_t> factor_a(call, levelsA);
    In<int32_t> factor_b(call, levelsB);
    OutMatrix<double> rows(call, table);
    Result<double> tail_a(call, pA);
    Result<double> tail_b(call, pB);
    Result<double> tail_ab(call, pAB);
    const int32_t n = observations.size();
    if (factor_a.size() != n || factor_b.size() != n) return call.Fail(kSizesDiffer);
    if (rows.Resize(4, 4)) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        const int32_t* const levels[] = {factor_a.data(), factor_b.data()};
        const int32_t counts[] = {*a, *b};
        double p[3];
        const int32_t status = AnalyseTwoWays(observations.data(), levels, n, *r, counts, Rows(rows), p);
        if (status != kOk) return status;
        *tail_a = p[0];
        *tail_b = p[1];
        *tail_ab = p[2];
        return kOk;
    });
}

int32_t ANOVA3Way_head(KrHandle y, KrHandle levelsA, KrHandle levelsB, KrHandle levelsC, const int32_t* r,
                       const int32_t* a, const int32_t* b, const int32_t* c, KrHandle table, double* pA, double* pB,
                       double* pC, double* pAB, double* pAC, double* pBC, double* pABC, int32_t* err) {
    ByReference call(err);
    In<double> observations(call, y);
    In<int32_t> factor_a(call, levelsA);
    In<int32_t> factor_b(call, levelsB);
    In<int32_t> factor_c(call, levelsC);
    OutMatrix<double> rows(call, table);
    Result<double> tail_a(call, pA);
    Result<double> tail_b(call, pB);
    Result<double> tail_c(call, pC);
    Result<double> tail_ab(call, pAB);
    Result<double> tail_ac(call, pAC);
    Result<double> tail_bc(call, pBC);
    Result<double> tail_abc(call, pABC);
    rows.Empty();
    const int32_t n = observations.size();
    if (factor_a.size() != n || factor_b.size() != n || factor_c.size() != n) return call.Fail(kSizesDiffer);
    if (rows.Resize(8, 4)) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        const int32_t* const levels[] = {factor_a.data(), factor_b.data(), factor_c.data()};
        const int32_t counts[] = {*a, *b, *c};
        double p[7];
        const int32_t status = AnalyseThreeWays(observations.data(), levels, n, *r, counts, Rows(rows), p);
        if (status != kOk) return status;
        *tail_a = p[0];
        *tail_b = p[1];
        *tail_c = p[2];
        *tail_ab = p[3];
        *tail_ac = p[4];
        *tail_bc = p[5];
        *tail_abc = p[6];
        return kOk;
    });
}

int32_t Contingency_head(KrHandle counts, double* chiSquare, double* p, int32_t* err) {
    ByReference call(err);
    InMatrix<int32_t> cells(call, counts);
    Result<double> statistic(call, chiSquare);
    Result<double> tail(call, p);
    return call.Run(
        [&] { return TestContingency(cells.data(), cells.rows(), cells.columns(), statistic.data(), tail.data()); });
}
