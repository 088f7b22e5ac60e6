#include "quarn/reports/ModelReport.h"

#include "quarn/reports/ModelTelling.h"
#include "quarn/session/Interruption.h"

namespace quarn::program {

Outcome reportModel(const std::filesystem::path& model, ReportForm form,
                    const CommonOptions& common) {
    watchForInterruption();
    ConsoleFrontEnd front_end(printsFor(common));
    HostSession host(front_end, common, HostSession::Use::numbers);
    const auto start = std::chrono::steady_clock::now();
    if (const auto trouble = host.readModel(model))
        return *trouble;
    ReadFile file{model, 0, std::chrono::steady_clock::now() - start, {}};
    std::error_code unknown; // it was read just now; whoever took it away since does no harm
    file.bytes = std::filesystem::file_size(model, unknown);
    file.contents = contentsOf(host.session().document());
    return Outcome::success(form == ReportForm::json ? jsonOf(file) : textOf(file));
}

} // namespace quarn::program
