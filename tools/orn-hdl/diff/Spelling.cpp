#include "diff/Spelling.h"

#include "diagnostics/JsonWriter.h"

#include <cstddef>

namespace Tool::Diff {

namespace {

std::string SpellPlace(const std::string& file, std::uint64_t line) {
    return line == 0 ? file : file + ":" + std::to_string(line);
}

/// "signal N", "pin U1.I: A -> B", with the places behind it.
std::string SpellDifference(const Difference& difference, const Report& report) {
    const Side& a = difference.a;
    const Side& b = difference.b;
    const bool isInA = !a.name.empty();
    const bool isInB = !b.name.empty();
    std::string text = std::string("   ").append(GetName(difference.thing)).append(" ");
    text.append(isInA ? a.name : b.name);
    if (isInA && isInB && a.name != b.name) {
        text.append(" -> ").append(b.name);
    }
    if (!difference.what.empty()) {
        text.append(", ").append(difference.what);
    }
    if (!a.text.empty() || !b.text.empty()) {
        text.append(": ").append(isInA ? a.text : b.text);
        if (isInA && isInB) {
            text.append(" -> ").append(b.text);
        }
    }
    text.append(" (");
    if (isInA) {
        text.append(SpellPlace(report.fileA, a.line));
    }
    if (isInB) {
        text.append(isInA ? ", " : "").append(SpellPlace(report.fileB, b.line));
    }
    return text.append(")\n");
}

void WriteSide(JsonWriter& json, const char* key, const Side& side) {
    if (side.name.empty()) {
        return;
    }
    json.Key(key).BeginObject();
    json.Key("name").Text(side.name);
    if (!side.text.empty()) {
        json.Key("text").Text(side.text);
    }
    if (side.line != 0) {
        json.Key("line").Number(side.line);
    }
    json.EndObject();
}

} // namespace

std::string SpellAsText(const Report& report) {
    const std::size_t total = report.all.GetTotal();
    if (total == 0) {
        return "no differences\n";
    }
    std::string text;
    std::size_t at = 0;
    std::string summary;
    for (std::size_t i = 0; i < ChangeCount; ++i) {
        const auto change = static_cast<Change>(i);
        const std::size_t count = report.all.GetCount(change);
        if (count == 0) {
            continue;
        }
        summary.append(summary.empty() ? ": " : ", ");
        summary.append(std::to_string(count)).append(" ").append(GetName(change));
        if (at < report.shown.size() && report.shown[at].change == change) {
            text.append(GetName(change)).append(":\n");
        }
        for (; at < report.shown.size() && report.shown[at].change == change; ++at) {
            text.append(SpellDifference(report.shown[at], report));
        }
    }
    if (report.shown.size() < total) {
        text.append("and ").append(std::to_string(total - report.shown.size())).append(" more\n");
    }
    text.append(std::to_string(total)).append(total == 1 ? " difference" : " differences");
    return text.append(summary).append("\n");
}

std::string SpellAsJson(const Report& report) {
    JsonWriter json;
    json.BeginObject();
    json.Key("a").Text(report.fileA);
    json.Key("b").Text(report.fileB);
    json.Key("counts").BeginObject();
    for (std::size_t i = 0; i < ChangeCount; ++i) {
        const auto change = static_cast<Change>(i);
        json.Key(GetName(change)).Number(report.all.GetCount(change));
    }
    json.EndObject();
    json.Key("differences").BeginArray();
    for (const Difference& difference : report.shown) {
        json.BeginObject();
        json.Key("change").Text(GetName(difference.change));
        json.Key("object").Text(GetName(difference.thing));
        if (!difference.what.empty()) {
            json.Key("what").Text(difference.what);
        }
        WriteSide(json, "a", difference.a);
        WriteSide(json, "b", difference.b);
        json.EndObject();
    }
    json.EndArray().EndObject();
    return json.Take();
}

} // namespace Tool::Diff
