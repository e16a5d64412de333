#include "bench/Report.h"

#include <algorithm>
#include <cstdio>
#include <fstream>
#include <nlohmann/json.hpp>

#include "bench/Counting.h"

namespace bench
{
namespace
{
constexpr double kMillion = 1e6;

std::string number(const char* format, double value)
{
    char text[32];
    std::snprintf(text, sizeof text, format, value);
    return text;
}

std::string duration(double seconds)
{
    if (seconds >= 1)
        return number("%.3f s", seconds);
    if (seconds >= 1e-3)
        return number("%.3f ms", seconds * 1e3);
    return seconds >= 1e-6 ? number("%.3f us", seconds * 1e6) : number("%.1f ns", seconds * 1e9);
}

std::string limit(double most)
{
    return most > 0 ? number("%g", most) : "-";
}

// What is close to 1 is told to the thousandth.
std::string shown(const Measured& measured, const std::string& unit)
{
    const bool isCloseToOne = measured.value >= 0.1 && measured.value < 10;
    return measured.value > 0 ? number(isCloseToOne ? "%.3f" : "%.4g", measured.value) + " " + unit : "";
}

std::string shownWobble(const Measured& measured)
{
    char text[32];
    std::snprintf(text, sizeof text, "%.1f %%",
                  measured.value > 0 ? measured.wobble / measured.value * 100 : 0);
    return measured.wobble > 0 ? text : "";
}

std::string verdict(const Figure& figure, bool judged)
{
    if (!judged || figure.most <= 0)
        return "";
    const std::string by = figure.by == kInstructions ? ", by instructions" : "";
    return (isMissed(figure.measured, figure.most) ? "MISSED" : "ok") + by;
}

void printFigure(const Figure& figure, bool judged)
{
    const bool isJudgedByTime = figure.by == kProcessorTime;
    const Measured& time = isJudgedByTime ? figure.measured : figure.time;
    const Measured& counted = isJudgedByTime ? figure.instructions : figure.measured;
    std::printf("%-66s %10s %7s %12s %7s %7s  %s\n", figure.what.c_str(), shown(time, figure.unit).c_str(),
                shownWobble(time).c_str(), shown(counted, figure.unit).c_str(), shownWobble(counted).c_str(),
                limit(figure.most).c_str(), verdict(figure, judged).c_str());
}

nlohmann::json asJson(const Measured& measured)
{
    return {{"value", measured.value}, {"wobble", measured.wobble}};
}

nlohmann::json asJson(const std::string& name, double units, const SamplesByName& samples)
{
    const auto found = samples.find(name);
    const Samples none;
    const Samples& all = found == samples.end() ? none : found->second;
    return {{"name", name},
            {"units", units},
            {"runs", all.seconds.size()},
            {"seconds", median(all.seconds)},
            {"instructions", median(all.instructions)}};
}

nlohmann::json asJson(const Figure& figure, const SamplesByName& samples)
{
    nlohmann::json json = asJson(figure.measured);
    json["what"] = figure.what;
    json["unit"] = figure.unit;
    json["most"] = figure.most;
    json["missed"] = isMissed(figure.measured, figure.most);
    json["by"] = figure.by == kInstructions ? "instructions" : "time";
    json["how"] = figure.how;
    json["source"] = figure.source;
    if (figure.measuredName.empty())
        return json;
    json["measured"] = asJson(figure.measuredName, figure.measuredUnits, samples);
    json["base"] = asJson(figure.baseName, figure.baseUnits, samples);
    return json;
}
} // namespace

void printMedians(const SamplesByName& samples)
{
    std::printf("\n%-66s %12s %7s %12s %6s\n", "benchmark", "median", "+-", "instr. 10^6", "runs");
    for (const auto& [name, all] : samples)
    {
        const Measured seconds = measuredOf(all.seconds);
        const double instructions = median(all.instructions) / kMillion;
        std::printf("%-66s %12s %7s %12s %6zu\n", name.c_str(), duration(seconds.value).c_str(),
                    shownWobble(seconds).c_str(),
                    instructions > 0 ? number("%.4g", instructions).c_str() : "", all.seconds.size());
    }
}

int printFigures(const std::vector<Figure>& figures, bool judged)
{
    std::printf("\n%-66s %10s %7s %12s %7s %7s\n", "ratio or figure", "value", "+-", "by instr.", "+-",
                "at most");
    for (const Figure& figure : figures)
        printFigure(figure, judged);
    const auto missed =
        std::count_if(figures.begin(), figures.end(),
                      [](const Figure& figure) { return isMissed(figure.measured, figure.most); });
    return judged ? static_cast<int>(missed) : 0;
}

bool writeFigures(const std::vector<Figure>& figures, const SamplesByName& samples, const std::string& path)
{
    nlohmann::json all = nlohmann::json::array();
    for (const Figure& figure : figures)
        all.push_back(asJson(figure, samples));
    std::ofstream file(path);
    file << nlohmann::json({{"whyNothingCounts", whyNothingCounts()}, {"figures", all}}).dump(1) << '\n';
    return static_cast<bool>(file.flush());
}
} // namespace bench
