#include "quarn/arguments/LightArguments.h"

#include "host/session/ColorWord.h"
#include "quarn/arguments/Readings.h"

#include <filesystem>

namespace quarn::program {

namespace {

using Answer = std::variant<std::string, Refusal>;

constexpr double MOST_STOPS = 10.0; // as the host takes them

Answer pictureAnswer(const std::string& option, const std::string& word) {
    if (const auto refusal = whyPathIsRefused("the path of " + option, word))
        return Refusal{*refusal};
    std::error_code error;
    if (!std::filesystem::is_regular_file(word, error))
        return Refusal{option + ": there is no picture " + word + "."};
    return "_Picture " + quotedPath(word);
}

Reading<std::string> surroundings() {
    return [](const std::string& option, const std::string& word) -> Answer {
        const std::string name = lowerCase(word);
        for (const auto& [choice, answer] :
             {std::pair("automatic", "_Automatic"), {"studio", "_Studio"}, {"sky", "_Sky"}})
            if (name == choice)
                return answer;
        return name.ends_with(".hdr")
                   ? pictureAnswer(option, word)
                   : mustBe(option, "studio, sky, automatic or a picture that ends in .hdr", word);
    };
}

Reading<std::string> exposure() {
    return [](const std::string& option, const std::string& word) -> Answer {
        if (lowerCase(word) == "automatic")
            return "_Automatic";
        const auto stops = realNumber(word);
        if (stops && *stops >= -MOST_STOPS && *stops <= MOST_STOPS)
            return numberText(*stops);
        return mustBe(option, "automatic or a number of stops from -10 to 10", word);
    };
}

Reading<std::string> background() {
    return [](const std::string& option, const std::string& word) -> Answer {
        if (lowerCase(word) == "transparent")
            return LightRequest::TRANSPARENT;
        if (lowerCase(word) == "automatic")
            return "_Automatic";
        if (const auto color = colorWord(word))
            return "_Colour \"" + *color + "\"";
        return mustBe(
            option, "transparent, automatic, black, grey, white or a colour such as ff8800", word);
    };
}

Reading<std::string> ground() {
    return [](const std::string& option, const std::string& word) -> Answer {
        const std::string name = lowerCase(word);
        if (name != "on" && name != "off")
            return mustBe(option, "on or off", word);
        return name == "on" ? "Yes" : "No";
    };
}

} // namespace

void addLight(const OptionAdder& add, LightRequest& light) {
    add("--light", light.surroundings, "WHAT", surroundings(),
        "What lights the model and shows in what mirrors: studio, sky or a picture, FILE.hdr "
        "(default: automatic, or the document's own)");
    add("--exposure", light.exposure, "STOPS", exposure(),
        "How bright, -10 to 10: 1 more is twice as bright (default: automatic, or the document's "
        "own)");
    add("--background", light.background, "COLOUR", background(),
        "What the model stands before: ff8800, black, grey, white or transparent, which needs png "
        "(default: automatic, or the document's own)");
    add("--ground", light.ground, "on|off", ground(),
        "Whether the model stands on a ground with its shadow (default: on, or the document's "
        "own)");
}

std::optional<std::string> whyLightIsMisused(const LightRequest& light, const std::string& format) {
    const std::string kind = lowerCase(format);
    if (!light.isTransparent() || kind == "png" || kind == "tga")
        return std::nullopt;
    return "--background transparent needs pictures of the kind png, not " + kind + ".";
}

} // namespace quarn::program
