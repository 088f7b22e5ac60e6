#include "import/obj/MaterialFile.h"

#include "import/text/LineCursor.h"
#include "import/text/Words.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace quarn {

namespace {

/// Some programs put a file's name between quotation marks.
std::string_view unquoted(std::string_view name) {
    const bool is_quoted = name.size() > 1 && name.front() == '"' && name.back() == '"';
    return is_quoted ? name.substr(1, name.size() - 2) : name;
}

/// Options of a picture that have one word behind them which does not matter here.
constexpr std::string_view OPTIONS_OF_A_WORD[] = {"-blendu",  "-blendv", "-cc",  "-texres",
                                                  "-imfchan", "-boost",  "-type"};

using Color = std::optional<std::array<float, 3>>;

constexpr std::pair<std::string_view, MaterialMap FileMaterial::*> MAPS[] = {
    {"map_Kd", &FileMaterial::color_map},     {"map_d", &FileMaterial::opacity_map},
    {"map_Ks", &FileMaterial::specular_map},  {"map_Ke", &FileMaterial::emission_map},
    {"map_Pr", &FileMaterial::roughness_map}, {"map_Pm", &FileMaterial::metalness_map},
    {"norm", &FileMaterial::normal_map},      {"map_Bump", &FileMaterial::bump_map},
    {"map_bump", &FileMaterial::bump_map},    {"bump", &FileMaterial::bump_map}};

constexpr std::pair<std::string_view, Color FileMaterial::*> COLORS[] = {
    {"Kd", &FileMaterial::color}, {"Ks", &FileMaterial::specular}, {"Ke", &FileMaterial::emission}};

constexpr std::pair<std::string_view, std::optional<float> FileMaterial::*> NUMBERS[] = {
    {"Ns", &FileMaterial::exponent},
    {"Pr", &FileMaterial::roughness},
    {"Pm", &FileMaterial::metalness},
    {"Pc", &FileMaterial::clearcoat},
    {"Pcr", &FileMaterial::clearcoat_roughness}};

/// What follows is passed over, so that a file of their names alone cannot fill the memory.
constexpr std::size_t MOST_MATERIALS = 100'000;

class Lines {
public:
    explicit Lines(std::string_view text) : m_lines(text, lineBreakOf(text)) {}

    MaterialFile read() {
        for (std::string_view line; m_file.materials.size() < MOST_MATERIALS && m_lines.next(line);)
            readLine(line);
        return std::move(m_file);
    }

private:
    void readLine(std::string_view line) {
        const std::string_view keyword = takeWord(line);
        if (keyword == "newmtl")
            m_file.materials.push_back({.name = trimmed(line)});
        else if (!m_file.materials.empty())
            readPart(keyword, line, m_file.materials.back());
    }

    void readPart(std::string_view keyword, std::string_view rest, FileMaterial& material) {
        for (const auto& [word, map] : MAPS)
            if (keyword == word)
                return readMap(rest, material.*map);
        for (const auto& [word, color] : COLORS)
            if (keyword == word)
                return readColor(rest, material.*color);
        for (const auto& [word, number] : NUMBERS)
            if (keyword == word)
                return readNumber(rest, material.*number);
        if (keyword == "d")
            readShare(rest, material.opacity);
        else if (keyword == "Tr")
            readShare(rest, material.transparency);
    }

    /// One number stands for three.
    void readColor(std::string_view rest, Color& stated) {
        std::array<float, 3> color{};
        std::size_t count = 0;
        while (count < color.size()) {
            const std::optional<float> number = takeNumber<float>(rest);
            if (!number)
                break;
            color[count++] = *number;
        }
        if (count == 0 || (count < 3 && !trimmed(rest).empty())) {
            fault(rest);
            return;
        }
        for (; count < color.size(); ++count)
            color[count] = color[0];
        stated = color;
    }

    void readShare(std::string_view rest, std::optional<float>& share) {
        std::string_view after = rest;
        if (takeWord(after) == "-halo") // see-through in the middle, opaque at the border
            rest = after;
        std::optional<float> number;
        readNumber(rest, number);
        if (number)
            share = std::clamp(*number, 0.0F, 1.0F);
    }

    void readNumber(std::string_view rest, std::optional<float>& stated) {
        std::string_view after = rest;
        const std::optional<float> number = takeNumber<float>(after);
        if (number && !std::isnan(*number))
            stated = number;
        else
            fault(rest);
    }

    void readMap(std::string_view rest, MaterialMap& map) {
        map = {};
        skipBlanks(rest);
        for (std::string_view after = rest; rest.starts_with('-'); rest = after) {
            if (!readOption(takeWord(after), after, map))
                break;
            skipBlanks(after);
        }
        map.file = unquoted(trimmed(rest));
    }

    /// @return false for a word that is no option: the name begins with it
    static bool readOption(std::string_view option, std::string_view& rest, MaterialMap& map) {
        if (option == "-clamp") {
            const TextureWrap wrap =
                takeWord(rest) == "on" ? TextureWrap::clamp : TextureWrap::repeat;
            map.wraps = {wrap, wrap};
        } else if (option == "-s") {
            readTwo(rest, map.place.u[0], map.place.v[1]);
        } else if (option == "-o") {
            readTwo(rest, map.place.u[2], map.place.v[2]);
        } else if (option == "-bm") {
            std::string_view factor = takeWord(rest);
            map.strength = takeNumber<float>(factor).value_or(map.strength);
        } else if (option == "-t") {
            double ignored = 0.0;
            readTwo(rest, ignored, ignored);
        } else if (option == "-mm") {
            takeWord(rest);
            takeWord(rest);
        } else if (std::ranges::find(OPTIONS_OF_A_WORD, option) !=
                   std::ranges::end(OPTIONS_OF_A_WORD)) {
            takeWord(rest);
        } else {
            return false;
        }
        return true;
    }

    /// The first two of one to three numbers; those that are missing stay as they are.
    static void readTwo(std::string_view& rest, double& u, double& v) {
        double third = 0.0;
        for (double* const number : {&u, &v, &third}) {
            const std::optional<double> read = takeNumber<double>(rest);
            if (!read)
                return;
            *number = *read;
        }
    }

    void fault(std::string_view rest) {
        if (m_file.fault.empty())
            m_file.fault = "line " + std::to_string(m_lines.number()) + " holds " +
                           quotedWord(takeWord(rest)) + " where a number belongs";
    }

    LineCursor m_lines;
    MaterialFile m_file;
};

} // namespace

MaterialFile readMaterialFile(std::string_view text) {
    return Lines(text).read();
}

} // namespace quarn
