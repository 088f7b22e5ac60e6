#include "host/commands/FormAsking.h"

#include "host/commands/WordsLeft.h"
#include "host/dialogs/DialogState.h"

#include <charconv>
#include <cmath>

namespace quarn {

bool mayAskInForm(const CQuarnCommandContext& context) {
    return context.IsInteractive() && !hasWordsLeft();
}

std::optional<CQuarnCommand::result> askInForm(const CQuarnCommandContext& context, CDialog& form) {
    if (!mayAskInForm(context))
        return std::nullopt;
    const std::optional<int> ended = DialogState::of(form).showWhereThereAreDialogs();
    if (ended == QnDialogConfirmed)
        return CQuarnCommand::success;
    return ended == QnDialogGivenUp ? std::optional(CQuarnCommand::cancel) : std::nullopt;
}

void exchangeWhole(CQnDialogExchange& exchange, int control, int& number, int least, int greatest) {
    DDX_Text(exchange, control, number);
    DDV_MinMaxDouble(exchange, number, least, greatest);
}

void exchangeRounded(CQnDialogExchange& exchange, int control, double& number, double shown) {
    double entered = shown;
    DDX_Text(exchange, control, entered);
    if (entered != shown)
        number = entered;
}

double roundedAngle(double degrees) {
    return std::round(degrees * 100) / 100 + 0.0; // no "-0"
}

double roundedLength(double length) {
    constexpr int digits = 7;
    char text[32];
    const auto written =
        std::to_chars(text, std::end(text), length, std::chars_format::general, digits);
    double rounded = length;
    std::from_chars(text, written.ptr, rounded);
    return rounded + 0.0; // no "-0"
}

} // namespace quarn
