#include "quarn/reports/CurveReport.h"

#include "quarn/session/Interruption.h"

namespace quarn::program {

Outcome reportCurves(const std::filesystem::path& model, const CommonOptions& common) {
    watchForInterruption();
    ConsoleFrontEnd front_end(printsFor(common));
    HostSession host(front_end, common, HostSession::Use::numbers);
    if (const auto trouble = host.readModel(model))
        return *trouble;
    front_end.keepWords();
    if (const auto trouble = host.run("_-List _Curves"))
        return *trouble;
    return Outcome::success(front_end.takeKeptWords());
}

} // namespace quarn::program
