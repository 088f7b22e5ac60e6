#include "host/curves/CurveDescription.h"

#include <nlohmann/json.hpp>

#include <iterator>
#include <optional>
#include <set>
#include <string>

namespace quarn {

namespace {

/// Walks over the text and counts lines, so that a message can name the one that was read last. It
/// is the line of the last character that is no blank: a reader looks one character ahead.
class LineCounting {
public:
    using iterator_category = std::input_iterator_tag;
    using value_type = char;
    using difference_type = std::ptrdiff_t;
    using pointer = const char*;
    using reference = const char&;

    LineCounting(const char* at, std::size_t* token_line) : m_at(at), m_token_line(token_line) {}

    const char& operator*() const { return *m_at; }
    LineCounting& operator++() {
        if (*m_at == '\n')
            ++m_line;
        else if (*m_at != ' ' && *m_at != '\t' && *m_at != '\r')
            *m_token_line = m_line;
        ++m_at;
        return *this;
    }
    LineCounting operator++(int) {
        const LineCounting before = *this;
        ++*this;
        return before;
    }
    friend bool operator==(const LineCounting& a, const LineCounting& b) {
        return a.m_at == b.m_at;
    }

private:
    const char* m_at;
    std::size_t* m_token_line;
    std::size_t m_line = 1;
};

/// Takes what is read piece by piece; nothing that is not wanted is kept, however deep or long.
class CurveTaking {
public:
    using json = nlohmann::json;

    const std::string& why() const { return m_why; }
    CurveDescription& curve() { return m_curve; }

    bool null() { return refuseValue(); }
    bool string(std::string&) { return refuseValue(); }
    bool binary(json::binary_t&) { return refuseValue(); }

    bool boolean(bool value) {
        if (m_key != "closed" || m_depth != 1)
            return refuseValue();
        m_curve.closed = value;
        return true;
    }
    bool number_integer(std::int64_t value) {
        return takesDegree() ? takeDegree(value) : takeNumber(static_cast<double>(value));
    }
    bool number_unsigned(std::uint64_t value) {
        constexpr std::uint64_t high = HIGHEST_DEGREE + 1;
        return takesDegree() ? takeDegree(static_cast<std::int64_t>(std::min(value, high)))
                             : takeNumber(static_cast<double>(value));
    }
    bool number_float(double value, const std::string&) {
        return takesDegree() ? refuseValue() : takeNumber(value);
    }

    bool start_object(std::size_t) {
        if (m_depth != 0)
            return refuseValue();
        m_depth = 1;
        return true;
    }
    bool end_object() {
        m_depth = 0;
        return true;
    }
    bool key(std::string& key) {
        if (key != "degree" && key != "closed" && key != "points")
            return refuse("a curve has \"degree\", \"closed\" and \"points\", and nothing else");
        if (!m_seen.insert(key).second)
            return refuse("\"" + key + "\" is there twice");
        m_key = key;
        return true;
    }
    bool start_array(std::size_t) {
        if (m_key != "points" || m_depth < 1 || m_depth > 2)
            return refuseValue();
        ++m_depth;
        m_numbers.clear();
        return true;
    }
    bool end_array() {
        --m_depth;
        return m_depth != 2 || takePoint();
    }

    bool parse_error(std::size_t, const std::string&, const json::exception& error) {
        return refuse(error.id == OUT_OF_RANGE ? "a number is too large"
                                               : "the JSON text is damaged or ends too early");
    }

private:
    static constexpr int OUT_OF_RANGE = 406;

    bool refuse(std::string why) {
        m_why = std::move(why);
        return false;
    }

    bool refuseValue() {
        if (m_depth == 1 && m_key == "degree")
            return refuseDegree();
        if (m_depth == 1 && m_key == "closed")
            return refuse("\"closed\" is true or false");
        return refuse("\"points\" is a list of points, each [x, y, z] or [x, y, z, weight]");
    }

    bool refuseDegree() {
        return refuse("\"degree\" is a whole number from 1 to " + std::to_string(HIGHEST_DEGREE));
    }

    bool takesDegree() const { return m_depth == 1 && m_key == "degree"; }

    bool takeDegree(std::int64_t degree) {
        if (degree < 1 || degree > HIGHEST_DEGREE)
            return refuseDegree();
        m_curve.degree = static_cast<int>(degree);
        return true;
    }

    bool takeNumber(double number) {
        if (m_depth != 3 || m_numbers.size() == 4)
            return refuseValue();
        m_numbers.push_back(number);
        return true;
    }

    bool takePoint() {
        if (m_curve.points.size() == CurveDescription::MOST_POINTS)
            return refuse("there are more than a million points");
        if (m_numbers.size() < 3)
            return refuseValue();
        const KM_3dPoint point(m_numbers[0], m_numbers[1], m_numbers[2]);
        const double weight = m_numbers.size() == 4 ? m_numbers[3] : 1.0;
        if (!point.IsValid())
            return refuse("a coordinate is no usable number");
        if (!KM_IsValid(weight) || !(weight > 0.0))
            return refuse("the weight of a point is a number above 0");
        m_curve.points.push_back(point);
        m_curve.weights.push_back(weight);
        return true;
    }

    CurveDescription m_curve;
    std::string m_why;
    std::string m_key;
    std::set<std::string> m_seen;
    int m_depth = 0; ///< 1 in the object, 2 in the list of points, 3 in a point
    std::vector<double> m_numbers;
};

} // namespace

Result<CurveDescription> readCurveJson(std::string_view text) {
    std::size_t line = 1;
    CurveTaking taking;
    const LineCounting begin(text.data(), &line);
    const LineCounting end(text.data() + text.size(), &line);
    if (!nlohmann::json::sax_parse(begin, end, &taking))
        return errorInLine(line, taking.why());
    return std::move(taking.curve());
}

} // namespace quarn
