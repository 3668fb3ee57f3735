// SPDX-License-Identifier: Apache-2.0
// Many points, one after the other, in processes of their own: a crash ends a process, not the campaign.
#pragma once

#include <cstddef>
#include <functional>
#include <iosfwd>
#include <string>
#include <vector>

#include "tests/faults/Run.h"

namespace Testing {

// One call of one request with one fault.
struct Point {
  const Request* request;
  std::size_t call;  // its place among the request's calls, from 1
  CallKey key;
  Fault fault;

  std::string name() const;  // "REQUEST@CALL:FAULT", as `faults_test --point` takes it
};

// Every point of the requests whose name contains the text.
std::vector<Point> points(const std::string& part = "");
// Throws std::invalid_argument where there is no such point.
Point pointOf(const std::string& name);

// Every n-th of them, so that requests, calls and kinds of fault all have their share.
std::vector<Point> share(const std::vector<Point>& all, std::size_t n);

enum class Verdict { Held, Wrong, Leaked, Crashed };
inline constexpr int verdictCount = 4;

struct Finding {
  Verdict verdict = Verdict::Held;
  std::string detail;
};

// Carries out one point, in this process.
Finding check(const Point& point);

struct Report {
  std::size_t counts[faultCount][verdictCount] = {};
  std::vector<std::string> failures;  // "VERDICT POINT: detail"

  std::size_t tried() const;
  std::size_t failed() const;
  void add(const Report& other);
};

// The table: a line for every kind of fault.
std::ostream& operator<<(std::ostream& stream, const Report& report);

// With `check`, or what a test puts in its place.
Report carryOut(const std::vector<Point>& points, unsigned processes,
                const std::function<Finding(const Point&)>& carryOutOne = check);

}  // namespace Testing
