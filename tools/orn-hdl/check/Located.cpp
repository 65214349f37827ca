#include "check/Located.h"

#include "Orn_Hdl/Containers/StringArray.h"
#include "Port/Ascii.h"
#include "Port/File.h"
#include "diagnostics/NameKey.h"
#include "diagnostics/Words.h"

#include <algorithm>
#include <string_view>
#include <unordered_map>

namespace Tool::Checking {

using Orn_Hdl::StringArray;
using std::string_view;
using Cause = Orn_Hdl::Check::Cause;
using Kind = Cause::Kind;

namespace {

std::string Base(string_view name) {
    const std::string normal = GetNameKey(name);
    const std::size_t end = normal.find(',') == std::string::npos ? normal.find('(') : normal.npos;
    return normal.substr(0, end);
}

/// What a line and a cause have in common.
std::string Key(Kind kind, const std::string& first, const std::string& second = {}) {
    std::string key(1, static_cast<char>('A' + static_cast<int>(kind)));
    return key.append(first).append("\n").append(second);
}

/// The key of a cause; what stands in for a port is looked for under the port's name.
std::string KeyOf(const Cause& cause) {
    switch (cause.kind) {
    case Kind::DesignName:
        return Key(cause.kind, "");
    case Kind::Signal:
        return Key(cause.kind, Base(cause.first), cause.second);
    case Kind::Alias:
        return Key(cause.kind, Base(cause.first), Base(cause.second));
    case Kind::Comment:
    case Kind::Library:
    case Kind::UseClause:
    case Kind::Include:
        return Key(cause.kind, cause.first);
    case Kind::Option: {
        Port::StringBase<char> phrase(cause.first);
        phrase.MakeUpper();
        return Key(cause.kind, std::string(phrase.GetView()));
    }
    default:
        return Key(cause.kind, GetNameKey(cause.first), GetNameKey(cause.second));
    }
}

/// Whether the last of several lines brought it in: each replaces what the earlier ones did.
bool IsLastLineMeant(Kind kind) {
    return kind == Kind::DesignName || kind == Kind::Connection || kind == Kind::Constant ||
           kind == Kind::Option;
}

/// The lines that matter, by what they and the causes have in common.
class Search {
public:
    explicit Search(std::vector<Located>& findings) {
        for (Located& located : findings) {
            Want(located.finding.cause, located.line, located.checkedAt);
            Want(located.finding.other, located.otherLine, located.checkedAt);
        }
    }

    bool IsDone() const noexcept { return missing_ == 0; }
    void Take(const StringArray& words, std::uint64_t line);
    /// Whether a line beginning with that word can matter.
    bool IsWorthSplitting(string_view line) const noexcept;

private:
    struct Place {
        std::uint64_t* line;
        std::uint64_t before;
    };

    void Want(const Cause& cause, std::uint64_t& line, std::uint64_t before);
    bool Wants(Kind kind) const noexcept { return kinds_[static_cast<std::size_t>(kind)]; }
    void Found(const std::string& key, Kind kind, std::uint64_t line);
    void TakeSignal(string_view name, std::uint64_t line);
    void TakeConnection(const StringArray& words, std::uint64_t line);
    void TakeConstant(const StringArray& words, std::uint64_t line);
    void TakeAttribute(const StringArray& words, std::uint64_t line);
    void TakeAdd(const StringArray& words, std::uint64_t line);
    void TakeText(const StringArray& words, int first, std::uint64_t line);

    std::unordered_map<std::string, std::vector<Place>> places_;
    std::array<bool, 32> kinds_ = {};
    /// How many places are not found yet, or can be found again.
    std::size_t missing_ = 0;
};

void Search::Want(const Cause& cause, std::uint64_t& line, std::uint64_t before) {
    if (cause.kind != Kind::Design) {
        places_[KeyOf(cause)].push_back({&line, before});
        kinds_[static_cast<std::size_t>(cause.kind)] = true;
        ++missing_;
    }
}

void Search::Found(const std::string& key, Kind kind, std::uint64_t line) {
    const auto found = places_.find(key);
    if (found == places_.end()) {
        return;
    }
    for (const Place& place : found->second) {
        if (line > place.before || (*place.line != 0 && !IsLastLineMeant(kind))) {
            continue;
        }
        if (*place.line == 0 && !IsLastLineMeant(kind)) {
            --missing_;
        }
        *place.line = line;
    }
}

/// Of "owner.pin", both; only the owner without a ".".
std::pair<std::string, std::string> SplitPath(string_view text) {
    const std::size_t dot = std::min(text.find('.'), text.size());
    return {GetNameKey(text.substr(0, dot)),
            GetNameKey(text.substr(std::min(dot + 1, text.size())))};
}

void Search::TakeSignal(string_view name, std::uint64_t line) {
    if (!Wants(Kind::Signal)) {
        return;
    }
    const std::string normal = GetNameKey(name);
    for (std::size_t start = 0; start < normal.size();) {
        const std::size_t end = std::min(normal.find_first_of(",\\", start), normal.size());
        const std::string piece = normal.substr(start, end - start);
        const std::string base = Base(piece);
        Found(Key(Kind::Signal, base), Kind::Signal, line);
        Found(Key(Kind::Signal, base, base == piece ? "scalar" : "bus"), Kind::Signal, line);
        start = end + 1;
    }
}

void Search::TakeConnection(const StringArray& words, std::uint64_t line) {
    const string_view target = words.GetView(3);
    TakeSignal(words.GetView(2), line);
    if (target.find('.') != string_view::npos) {
        if (Wants(Kind::Connection)) {
            const auto [owner, pin] = SplitPath(target);
            Found(Key(Kind::Connection, owner, pin), Kind::Connection, line);
        }
        return;
    }
    TakeSignal(target, line);
    if (Wants(Kind::Alias)) {
        Found(Key(Kind::Alias, Base(words.GetView(2)), Base(target)), Kind::Alias, line);
    }
}

/// A constant on a pin is one on a signal of its own.
void Search::TakeConstant(const StringArray& words, std::uint64_t line) {
    const string_view target = words.GetView(2);
    if (target.find('.') == string_view::npos) {
        TakeSignal(target, line);
        Found(Key(Kind::Constant, GetNameKey(target)), Kind::Constant, line);
        return;
    }
    const auto [owner, pin] = SplitPath(target);
    const std::size_t range = std::min(pin.find('('), pin.size());
    const std::string signal = owner + "_" + pin.substr(0, range) + "_const_signal";
    Found(Key(Kind::Connection, owner, pin), Kind::Connection, line);
    Found(Key(Kind::Constant, signal + pin.substr(range)), Kind::Constant, line);
    Found(Key(Kind::Signal, signal), Kind::Signal, line);
}

/// ADD or SET, the kind of object, ATTRIBUTE, perhaps a word more, the object, perhaps a type, the
/// attribute.
void Search::TakeAttribute(const StringArray& words, std::uint64_t line) {
    const bool isSet = IsWord(words, 0, "SET");
    const bool isModule = IsWord(words, 1, "MODULE");
    const Kind kind = isModule                        ? Kind::ModuleAttribute
                      : IsWord(words, 1, "COMPONENT") ? Kind::ComponentAttribute
                      : IsWord(words, 1, "INSTANCE")  ? Kind::InstanceAttribute
                                                      : Kind::SignalAttribute;
    int at = isSet ? 4 : 3;
    const std::string owner = isModule ? std::string() : GetNameKey(words.GetView(at++));
    if (!isSet && Port::EqualIgnoringCase(words.GetView(at).substr(0, 6), "-TYPE=")) {
        ++at;
    }
    Found(Key(kind, owner, GetNameKey(words.GetView(at))), kind, line);
}

/// The words of a comment, joined as the command joins them.
void Search::TakeText(const StringArray& words, int first, std::uint64_t line) {
    std::string text;
    for (int i = first; i < words.GetSize(); ++i) {
        text.append(i > first ? " " : "").append(words.GetView(i));
    }
    Found(Key(Kind::Comment, text), Kind::Comment, line);
}

void Search::TakeAdd(const StringArray& words, std::uint64_t line) {
    const string_view first = words.GetView(2);
    if (IsWord(words, 2, "ATTRIBUTE")) {
        TakeAttribute(words, line);
    } else if (IsWord(words, 2, "COMMENT")) {
        TakeText(words, IsWord(words, 1, "MODULE") ? 3 : 4, line);
    } else if (IsWord(words, 1, "COMPONENT")) {
        Found(Key(Kind::Component, GetNameKey(first)), Kind::Component, line);
    } else if (IsWord(words, 1, "PIN")) {
        Found(Key(Kind::Pin, GetNameKey(first), GetNameKey(words.GetView(3))), Kind::Pin, line);
    } else if (IsWord(words, 1, "INSTANCE")) {
        Found(Key(Kind::Instance, GetNameKey(words.GetView(3))), Kind::Instance, line);
    } else if (IsWord(words, 1, "PORT") || IsWord(words, 1, "SIGNAL")) {
        TakeSignal(first, line);
    } else if (IsWord(words, 1, "NOTES")) {
        TakeText(words, 2, line);
    } else if (IsWord(words, 1, "LIBRARY")) {
        Found(Key(Kind::Library, std::string(first)), Kind::Library, line);
    } else if (IsWord(words, 1, "USE")) {
        Found(Key(Kind::UseClause, std::string(words.GetView(3))), Kind::UseClause, line);
    } else if (IsWord(words, 1, "INCLUDE")) {
        Found(Key(Kind::Include, std::string(first)), Kind::Include, line);
    }
}

void Search::Take(const StringArray& words, std::uint64_t line) {
    if (IsWord(words, 0, "ADD")) {
        TakeAdd(words, line);
    } else if (IsWord(words, 0, "CONNECT")) {
        TakeConnection(words, line);
    } else if (IsWord(words, 0, "ASSIGN")) {
        TakeConstant(words, line);
    } else if (IsWord(words, 0, "SET") && IsWord(words, 1, "NETLIST")) {
        Found(Key(Kind::DesignName, ""), Kind::DesignName, line);
    } else if (IsWord(words, 0, "SET") && IsWord(words, 2, "ATTRIBUTE")) {
        TakeAttribute(words, line);
    } else if (IsWord(words, 0, "USE")) {
        Found(Key(Kind::Option, "USE DEFAULT LIBRARY"), Kind::Option, line);
    } else if (IsWord(words, 0, "SUPPRESS") && IsWord(words, 1, "COMPONENT")) {
        Found(Key(Kind::Option, "SUPPRESS COMPONENT"), Kind::Option, line);
    }
}

/// Most lines of a large file wire pins; they are read only when a signal or a wire is looked for.
bool Search::IsWorthSplitting(string_view line) const noexcept {
    line.remove_prefix(std::min(line.find_first_not_of(' '), line.size()));
    const char first = line.empty() ? ' ' : Port::ToUpper(line.front());
    if (first == 'C') {
        return Wants(Kind::Signal) || Wants(Kind::Connection) || Wants(Kind::Alias);
    }
    if (first != 'A') {
        return true;
    }
    // "ADD INSTANCE", "ADD SIGNAL" and "ADD PORT" are as frequent.
    const std::size_t blank = std::min(line.find(' '), line.size());
    const string_view second = line.substr(blank, 10);
    if (Port::EqualIgnoringCase(second, " INSTANCE ")) {
        return Wants(Kind::Instance) || Wants(Kind::InstanceAttribute) || Wants(Kind::Comment);
    }
    if (Port::EqualIgnoringCase(second.substr(0, 8), " SIGNAL ")) {
        return Wants(Kind::Signal) || Wants(Kind::SignalAttribute) || Wants(Kind::Comment);
    }
    return true;
}

/// The lines of a file, as the replay reads them.
class Lines {
public:
    bool Open(const char* name) { return file_.open(name, Port::File::Read, true); }
    bool Next(string_view& line) {
        std::size_t end = buffer_.find('\n', start_);
        while (end == std::string::npos && Fill()) {
            end = buffer_.find('\n', start_);
        }
        if (end == std::string::npos && start_ == buffer_.size()) {
            return false;
        }
        const std::size_t stop = std::min(end, buffer_.size());
        line = string_view(buffer_).substr(start_, stop - start_);
        if (!line.empty() && line.back() == '\r') {
            line.remove_suffix(1);
        }
        start_ = std::min(stop + 1, buffer_.size());
        return true;
    }
    bool IsGood() const noexcept { return file_.GetError() == 0; }

private:
    bool Fill() {
        constexpr std::size_t Piece = std::size_t(1) << 18;
        buffer_.erase(0, start_);
        start_ = 0;
        const std::size_t size = buffer_.size();
        buffer_.resize(size + Piece);
        const std::size_t count = file_.read(buffer_.data() + size, Piece);
        buffer_.resize(size + count);
        return count > 0;
    }

    Port::File file_;
    std::string buffer_;
    std::size_t start_ = 0;
};

} // namespace

bool Locate(const char* systemName, std::vector<Located>& findings) {
    Search search(findings);
    Lines lines;
    if (search.IsDone()) {
        return true;
    }
    if (!lines.Open(systemName)) {
        return false;
    }
    StringArray words;
    string_view line;
    for (std::uint64_t number = 1; !search.IsDone() && lines.Next(line); ++number) {
        if (search.IsWorthSplitting(line)) {
            words.Empty();
            words.ParseCommandLine(line.substr(0, std::min(line.find('\0'), line.size())));
            search.Take(words, number);
        }
    }
    return lines.IsGood();
}

} // namespace Tool::Checking
