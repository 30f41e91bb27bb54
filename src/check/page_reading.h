#pragma once

#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "base/text.h"
#include "check/checked_page.h"
#include "check/finding.h"
#include "check/html_reader.h"
#include "check/tables.h"
#include "markup/template_source.h"

namespace zebtell::check {

// One template being checked, for one page.
struct PageReading {
    const CheckedPage& page;
    const markup::TemplateSource& source;
    const Tables& tables;
    std::vector<std::string> queries = {};  // names of the queries that the page defines
    std::vector<Finding> findings = {};

    // `where` begins in the source's text.
    void Report(std::string_view where, std::string text) {
        const auto offset = static_cast<std::size_t>(where.data() - source.text.data());
        auto [file, line] = source.PlaceOf(offset);
        findings.push_back({std::move(file), line, std::move(text)});
    }
};

}  // namespace zebtell::check
