#include "quarn/reports/CurveReport.h"

#include "quarn/session/HostSession.h"
#include "quarn/session/Interruption.h"

namespace quarn::program {

Outcome reportCurves(const CurvesOptions& options) {
    watchForInterruption();
    ConsoleFrontEnd front_end(printsFor(options.common));
    HostSession host(front_end, options.common);
    if (const auto trouble = host.readModel(options.model))
        return *trouble;
    front_end.keepWords();
    if (const auto trouble = host.run("_-List _Curves"))
        return *trouble;
    return Outcome::success(front_end.keptWords());
}

} // namespace quarn::program
