#include "bench/Judging.h"

#include <algorithm>
#include <cmath>

namespace bench
{
namespace
{
// Part of the way from the least value to the greatest, 0.5 for the median; between two values in proportion.
double quantile(std::vector<double> values, double part)
{
    if (values.empty())
        return 0;
    std::sort(values.begin(), values.end());
    const double place = part * static_cast<double>(values.size() - 1);
    const auto below = static_cast<std::size_t>(place);
    const std::size_t above = std::min(below + 1, values.size() - 1);
    return std::lerp(values[below], values[above], place - static_cast<double>(below));
}

// Where there are more of one, each of the others is the partner of several.
std::vector<double> ratiosByPlace(const std::vector<double>& measured, const std::vector<double>& base)
{
    const std::size_t count = std::max(measured.size(), base.size());
    std::vector<double> ratios;
    for (std::size_t i = 0; i < count; ++i)
        ratios.push_back(measured[i * measured.size() / count] / base[i * base.size() / count]);
    return ratios;
}

const std::vector<double>& samplesOf(const std::string& name, const SamplesByName& samples, By by)
{
    static const std::vector<double> none;
    const auto found = samples.find(name);
    return found == samples.end() ? none : found->second.of(by);
}

std::set<std::string> namesInDoubt(const std::vector<Ratio>& ratios, const SamplesByName& samples)
{
    std::set<std::string> names;
    for (const Ratio& ratio : ratios)
        if (isInDoubt(measuredRatio(ratio, samples, ratio.by), ratio.most))
            names.insert({ratio.measured, ratio.base});
    return names;
}
} // namespace

double median(std::vector<double> values)
{
    return quantile(std::move(values), 0.5);
}

Measured measuredOf(const std::vector<double>& values)
{
    return {median(values), (quantile(values, 0.75) - quantile(values, 0.25)) / 2};
}

Measured measuredRatio(const Ratio& ratio, const SamplesByName& samples, By by)
{
    const std::vector<double>& measured = samplesOf(ratio.measured, samples, by);
    const std::vector<double>& base = samplesOf(ratio.base, samples, by);
    if (median(base) <= 0 || measured.empty())
        return {};
    const double units = ratio.baseUnits / ratio.measuredUnits;
    const double wobble = measuredOf(ratiosByPlace(measured, base)).wobble;
    return {median(measured) / median(base) * units, wobble * units};
}

bool isMissed(const Measured& measured, double most)
{
    return most > 0 && !(measured.value > 0 && measured.value <= most);
}

bool isInDoubt(const Measured& measured, double most)
{
    return most > 0 && measured.value > 0 && std::abs(measured.value - most) <= measured.wobble;
}

void runWhileInDoubt(const std::vector<Ratio>& ratios, const SamplesByName& samples,
                     const std::function<void(const std::set<std::string>& names)>& runAgain)
{
    for (int times = 0; times < kMostRunsAgain; ++times)
    {
        const std::set<std::string> names = namesInDoubt(ratios, samples);
        if (names.empty())
            return;
        runAgain(names);
    }
}
} // namespace bench
