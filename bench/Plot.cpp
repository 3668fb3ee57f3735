// SPDX-License-Identifier: Apache-2.0
#include <algorithm>
#include <cmath>
#include <utility>

#include "bench/Page.h"

namespace Benchmark {
namespace {

struct Series {
  std::string name;
  const char* colour;
  std::vector<std::pair<double, double>> points;
};

// Whole powers of ten that hold all of the values.
struct Axis {
  int from = 0;
  int to = 1;

  explicit Axis(const std::vector<double>& values) {
    if (const auto [least, most] = std::ranges::minmax_element(values); least != values.end()) {
      from = static_cast<int>(std::floor(std::log10(*least)));
      to = std::max(from + 1, static_cast<int>(std::ceil(std::log10(*most))));
    }
  }

  double share(double value) const { return (std::log10(value) - from) / (to - from); }
};

constexpr double width = 420;
constexpr double height = 300;

std::string number(double value) { return std::to_string(static_cast<int>(std::lround(value))); }

std::string text(double x, double y, const char* anchor, const std::string& words, const std::string& more = {}) {
  return "<text x=\"" + number(x) + "\" y=\"" + number(y) + "\" text-anchor=\"" + anchor + "\"" + more + ">" + words +
         "</text>\n";
}

std::string line(double x1, double y1, double x2, double y2, const char* colour) {
  return "<line x1=\"" + number(x1) + "\" y1=\"" + number(y1) + "\" x2=\"" + number(x2) + "\" y2=\"" + number(y2) +
         "\" stroke=\"" + colour + "\"/>\n";
}

// "1,000" up to a million, above it "10⁹".
std::string power(int exponent) {
  if (exponent < 0) {
    return "0." + std::string(static_cast<std::size_t>(-exponent - 1), '0') + "1";
  }
  if (exponent <= 6) {
    return shown(std::pow(10, exponent));
  }
  return "10<tspan dy=\"-5\" font-size=\"9\">" + std::to_string(exponent) + "</tspan>";
}

// One panel, its lower left corner at (left, bottom).
std::string panel(double left, double bottom, const std::string& title, const std::vector<Series>& series) {
  std::vector<double> sizes;
  std::vector<double> costs;
  for (const Series& one : series) {
    for (const auto& [size, cost] : one.points) {
      sizes.push_back(size);
      costs.push_back(cost);
    }
  }
  const Axis across(sizes);
  const Axis up(costs);
  const auto x = [&](double size) { return left + across.share(size) * width; };
  const auto y = [&](double cost) { return bottom - up.share(cost) * height; };
  std::string svg = text(left, bottom - height - 14, "start", title, " font-weight=\"bold\"");
  for (int exponent = across.from; exponent <= across.to; ++exponent) {
    const double at = x(std::pow(10, exponent));
    svg += line(at, bottom, at, bottom - height, "#ddd") + text(at, bottom + 18, "middle", power(exponent));
  }
  for (int exponent = up.from; exponent <= up.to; ++exponent) {
    const double at = y(std::pow(10, exponent));
    svg += line(left, at, left + width, at, "#ddd") + text(left - 6, at + 4, "end", power(exponent));
  }
  svg += text(left + width / 2, bottom + 38, "middle", "instances");
  double legend = bottom - height + 18;
  for (const Series& one : series) {
    std::string points;
    for (const auto& [size, cost] : one.points) {
      points += number(x(size)) + ',' + number(y(cost)) + ' ';
      svg += "<circle cx=\"" + number(x(size)) + "\" cy=\"" + number(y(cost)) + "\" r=\"3\" fill=\"" + one.colour +
             "\"/>\n";
    }
    svg += "<polyline points=\"" + points + "\" fill=\"none\" stroke=\"" + one.colour + "\" stroke-width=\"2\"/>\n";
    svg += line(left + 10, legend - 4, left + 34, legend - 4, one.colour) + text(left + 40, legend, "start", one.name);
    legend += 18;
  }
  return svg;
}

Series seriesOf(const Results& results, std::string name, const char* colour, double Size::*cost) {
  Series series{std::move(name), colour, {}};
  for (const auto& [instances, size] : results.sizes) {
    if (size.*cost > 0) {
      series.points.emplace_back(instances, size.*cost);
    }
  }
  return series;
}

}  // namespace

std::string plotOf(const Results& results) {
  constexpr double margin = 70;
  const double bottom = height + margin;
  const std::vector<Series> instructions = {
      seriesOf(results, "a request of CIM-XML", "#1f5fa8", &Size::request),
      seriesOf(results, "the library, as an up-call", "#b3541e", &Size::library),
      seriesOf(results, "the minimal provider, as an up-call", "#4c8c3f", &Size::minimal)};
  const std::vector<Series> milliseconds = {seriesOf(results, "a request over HTTP", "#1f5fa8", &Size::milliseconds),
                                            seriesOf(results, "an HTTP echo of the same bytes", "#777", &Size::echo)};
  return "<svg xmlns=\"http://www.w3.org/2000/svg\" width=\"" + number(2 * width + 3 * margin) + "\" height=\"" +
         number(height + 2 * margin) +
         "\" font-family=\"sans-serif\" font-size=\"12\">\n<rect width=\"100%\" height=\"100%\" fill=\"white\"/>\n" +
         panel(margin, bottom, "Instructions", instructions) +
         panel(2 * margin + width, bottom, "Milliseconds, on the machine that measured", milliseconds) + "</svg>\n";
}

}  // namespace Benchmark
