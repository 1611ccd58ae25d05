// Runs the rules of this folder's JSON files through the interface by name, the way every face does.
//
//     varnex3_rules tests/rules              all files
//     varnex3_rules tests/rules SourceDef    the files whose name begins so
//
// README.md describes the files.
#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <map>
#include <random>
#include <string>
#include <vector>

#include "tests/rules/Values.h"
#include "varnex3/Library.h"
#include "varnex3/core/Conversions.h"
#include "varnex3/core/Error.h"

namespace {

using namespace varnex3;
using namespace varnex3::tests;

// ---------------------------------------------------------------- one rule

class Rule
{
public:
    explicit Rule(fs::path messages_) : messages(std::move(messages_)) {}
    ~Rule()
    {
        for (const auto& [name, path] : folders)
            fs::remove_all(path);
    }
    Rule(const Rule&) = delete;
    Rule& operator=(const Rule&) = delete;

    void Do(const Json& step);
    bool HasChecked() const { return hasChecked; }

private:
    void DoNew(const Json& step);
    void DoPut(const Json& step);
    void DoKeep(const Json& step);
    void DoRaises(const Json& step);
    void DoNothing(const Json& step);
    void DoSame(const Json& step);
    void DoMembers(const Json& step);
    void DoRepeat(const Json& step);
    void DoFolder(const Json& step);
    void DoContent(const Json& step);
    void DoAbsent(const Json& step);

    std::vector<Variant> DoCall(const Json& step, std::size_t& next);
    void DoAndCompare(const Json& step);
    void Compare(const Json& expected, const Json& got);

    Record& Object(const Json& name);
    std::string AsPath(std::string text) const;
    std::string Filled(std::string text) const;
    std::string PlainText(const Json& json) const;
    Variant ToVariant(const Json& json);
    std::vector<Variant> ToVariants(const Json& list);

    fs::path messages;
    std::map<std::string, Ref<Record>> objects;
    std::map<std::string, std::string> folders;
    std::string turn; // ${i} in a repeated step
    bool hasChecked = false;
};

Record& Rule::Object(const Json& name)
{
    const auto found = objects.find(name.get<std::string>());
    if (found == objects.end() || !found->second)
        throw Failure("no object " + Shown(name));
    return *found->second;
}

// A text of a rule with folders, its slashes as the system writes them.
std::string Rule::AsPath(std::string text) const
{
    constexpr char kSeparator = static_cast<char>(fs::path::preferred_separator);
    if (!folders.empty())
        std::ranges::replace(text, '/', kSeparator);
    return text;
}

// The text with ${i} and the paths of the rule's folders filled in, the slashes behind these as the system writes them.
std::string Rule::Filled(std::string text) const
{
    const auto fill = [&](const std::string& name, const std::string& value) {
        const std::string mark = "${" + name + "}";
        for (std::size_t at = 0; (at = text.find(mark, at)) != std::string::npos; at += value.size())
            text.replace(at, mark.size(), value);
    };
    fill("i", turn);
    for (const auto& [name, path] : folders) {
        if (text.find("${" + name + "}") != std::string::npos)
            text = AsPath(text);
        fill(name, path);
    }
    return text;
}

// A text, given as it is, as lines that each end with CR LF, or as a golden file.
std::string Rule::PlainText(const Json& json) const
{
    if (json.is_string())
        return Filled(json);
    if (json.contains("file"))
        return BytesOf(messages / json["file"].get<std::string>());
    std::string text;
    for (const Json& line : json.at("lines"))
        text += Filled(line) + "\r\n";
    return text;
}

Variant Rule::ToVariant(const Json& json)
{
    if (json.is_null())
        return Empty;
    if (json.is_boolean())
        return json.get<bool>();
    if (json.is_number()) {
        const auto number = json.get<double>();
        const bool isInt32 = json.is_number_integer() && number >= -2147483648.0 && number <= 2147483647.0;
        return isInt32 ? Variant(static_cast<std::int32_t>(number)) : Variant(number);
    }
    if (json.is_object() && json.contains("date"))
        return DateFrom(ToUtf16(json["date"].get<std::string>()));
    if (json.is_object() && json.contains("nothing"))
        return Ref<Record>();
    if (json.is_object() && json.contains("object"))
        return Ref<Record>(&Object(json["object"]));
    return ToUtf16(PlainText(json));
}

std::vector<Variant> Rule::ToVariants(const Json& list)
{
    std::vector<Variant> values;
    for (const Json& json : list)
        values.push_back(ToVariant(json));
    return values;
}

void Rule::Compare(const Json& expected, const Json& got)
{
    hasChecked = true;
    if (expected.is_object() && expected.contains("like")) {
        if (!got.is_string() || !IsLike(got.get<std::string>(), Filled(expected["like"])))
            Differ(expected, got);
        return;
    }
    const bool isText =
        expected.is_string() || (expected.is_object() && (expected.contains("lines") || expected.contains("file")));
    const Json wanted = isText ? Json(PlainText(expected)) : expected;
    if (wanted != got || wanted.is_boolean() != got.is_boolean())
        Differ(wanted, got);
}

// The result of a step that calls, followed by what came back in its arguments; next: where what is expected begins.
std::vector<Variant> Rule::DoCall(const Json& step, std::size_t& next)
{
    const std::string verb = step.at(0);
    const bool isFunction = verb == "function";
    const ClassInfo* const info = isFunction ? FindClass(step.at(1).get<std::string>()) : &Object(step.at(1)).Class();
    if (!info)
        throw Failure("no module " + Shown(step.at(1)));
    const std::string name = step.at(2);
    std::vector<Variant> arguments = verb == "get" ? std::vector<Variant>() : ToVariants(step.at(3));
    next = verb == "get" ? 3 : 4;
    const bool isProperty = verb == "get" || verb == "getAt";
    std::vector<Variant> results;
    if (isProperty)
        results.push_back(Get(Object(step.at(1)), name, arguments));
    else
        results.push_back(Call(*info, isFunction ? nullptr : &Object(step.at(1)), name, arguments));
    const auto parameters = FindMember(*info, name)->Parameters();
    for (std::size_t i = 0; i < arguments.size(); ++i)
        if (parameters[i].isOutput)
            results.push_back(arguments[i]);
    return results;
}

void Rule::DoAndCompare(const Json& step)
{
    std::size_t next = 0;
    const std::vector<Variant> results = DoCall(step, next);
    for (std::size_t i = 0; next + i < step.size(); ++i) {
        if (i >= results.size())
            throw Failure("no result for " + Shown(step[next + i]));
        Compare(step[next + i], ToJson(results[i]));
    }
}

void Rule::DoNew(const Json& step)
{
    const ClassInfo* const info = FindClass(step.at(2).get<std::string>());
    if (!info || info->IsModule())
        throw Failure("no class " + Shown(step.at(2)));
    objects[step.at(1)] = info->create();
}

void Rule::DoPut(const Json& step)
{
    const bool isIndexed = step.at(0) == "putAt";
    std::vector<Variant> indexes = isIndexed ? ToVariants(step.at(3)) : std::vector<Variant>();
    Put(Object(step.at(1)), step.at(2).get<std::string>(), ToVariant(step.at(isIndexed ? 4 : 3)), indexes);
}

void Rule::DoKeep(const Json& step)
{
    std::size_t next = 0;
    const Variant result = DoCall(step.at(2), next).front();
    const auto* const record = std::get_if<Ref<Record>>(&result);
    if (!record || !*record)
        Differ("an object", ToJson(result));
    objects[step.at(1)] = *record;
}

void Rule::DoRaises(const Json& step)
{
    hasChecked = true;
    const bool hasWords = step.size() == 5;
    const std::string expected = Shown(step.at(1)) + " from " + step.at(2).get<std::string>();
    try {
        Do(step.back());
    } catch (const Error& error) {
        const std::string got = std::to_string(error.Number()) + " from " + ToUtf8(error.Source());
        const std::string description = ToUtf8(error.Description());
        if (got != expected)
            throw Failure("expected error " + expected + ", got " + got + ": " + Shown(description));
        if (hasWords && description.find(AsPath(Filled(step[3]))) == std::string::npos)
            throw Failure("expected the description to say " + Shown(step[3]) + ", got " + Shown(description));
        return;
    }
    throw Failure("expected error " + expected + ", got none");
}

void Rule::DoNothing(const Json& step)
{
    std::size_t next = 0;
    Compare(Json{{"nothing", true}}, ToJson(DoCall(step.at(1), next).front()));
}

void Rule::DoSame(const Json& step)
{
    hasChecked = true;
    if (&Object(step.at(1)) != &Object(step.at(2)))
        throw Failure("expected one object, got two");
}

void Rule::DoMembers(const Json& step)
{
    const ClassInfo* const info = FindClass(step.at(1).get<std::string>());
    if (!info)
        throw Failure("no class " + Shown(step.at(1)));
    Json members = Json::array();
    for (const Member& member : info->members)
        members.push_back(Words(member));
    Compare(step.at(2), members);
}

void Rule::DoRepeat(const Json& step)
{
    for (int i = 0; i < step.at(1).get<int>(); ++i) {
        turn = std::to_string(i);
        Do(step.at(2));
    }
}

fs::path NewFolder()
{
    const fs::path path = fs::temp_directory_path() / ("varnex3-rule-" + std::to_string(std::random_device()()));
    if (!fs::create_directory(path))
        throw Failure("no temporary folder");
    return path;
}

void Rule::DoFolder(const Json& step)
{
    const fs::path path = NewFolder();
    folders[step.at(1)] = path.string();
    for (const auto& [name, content] : step.at(2).items()) {
        const fs::path file = path / ToUtf16(name);
        fs::create_directories(file.parent_path());
        if (content.is_null()) {
            fs::create_directory(file);
            continue;
        }
        const bool isBase64 = content.is_object() && content.contains("base64");
        std::ofstream(file, std::ios::binary) << (isBase64 ? FromBase64(content["base64"]) : PlainText(content));
    }
}

void Rule::DoContent(const Json& step) { Compare(step.at(2), BytesOf(Filled(step.at(1)))); }

void Rule::DoAbsent(const Json& step)
{
    hasChecked = true;
    if (fs::exists(Filled(step.at(1))))
        throw Failure("expected no file " + Filled(step[1]));
}

void Rule::Do(const Json& step)
{
    using Verb = void (Rule::*)(const Json&);
    static const std::map<std::string, Verb> verbs = {{"new", &Rule::DoNew},
                                                      {"put", &Rule::DoPut},
                                                      {"putAt", &Rule::DoPut},
                                                      {"get", &Rule::DoAndCompare},
                                                      {"getAt", &Rule::DoAndCompare},
                                                      {"call", &Rule::DoAndCompare},
                                                      {"function", &Rule::DoAndCompare},
                                                      {"keep", &Rule::DoKeep},
                                                      {"raises", &Rule::DoRaises},
                                                      {"nothing", &Rule::DoNothing},
                                                      {"same", &Rule::DoSame},
                                                      {"members", &Rule::DoMembers},
                                                      {"repeat", &Rule::DoRepeat},
                                                      {"folder", &Rule::DoFolder},
                                                      {"content", &Rule::DoContent},
                                                      {"absent", &Rule::DoAbsent}};
    const auto verb = verbs.find(step.at(0).get<std::string>());
    if (verb == verbs.end())
        throw Failure("no verb " + Shown(step.at(0)));
    (this->*verb->second)(step);
}

// What is wrong with a rule; nothing when it holds.
std::string FaultOf(const Json& vector, const fs::path& messages)
{
    Rule rule(messages);
    const Json* current = &vector;
    try {
        for (const Json& step : vector.at("steps")) {
            current = &step;
            rule.Do(step);
        }
        return rule.HasChecked() ? "" : "checks nothing";
    } catch (const std::exception& error) {
        return Shown(*current) + ": " + error.what();
    }
}

} // namespace

int main(int argc, char** argv)
{
    if (argc < 2) {
        std::cerr << "usage: varnex3_rules FOLDER [NAME...]\n";
        return 2;
    }
    const fs::path folder = argv[1];
    std::vector<fs::path> files;
    for (const fs::directory_entry& entry : fs::directory_iterator(folder)) {
        const bool isWanted = argc == 2 || std::any_of(argv + 2, argv + argc, [&](const std::string& name) {
                                  return entry.path().filename().string().starts_with(name);
                              });
        if (entry.path().extension() == ".json" && isWanted)
            files.push_back(entry.path());
    }
    std::ranges::sort(files);

    int passed = 0;
    int failed = 0;
    for (const fs::path& file : files) {
        const Json rules = Json::parse(BytesOf(file));
        for (const Json& rule : rules) {
            const std::string fault = FaultOf(rule, folder.parent_path() / "messages");
            if (fault.empty()) {
                ++passed;
                continue;
            }
            ++failed;
            std::cout << file.filename().string() << ": " << rule.at("rule").get<std::string>() << ": " << fault
                      << "\n";
        }
    }
    std::cout << passed << " passed, " << failed << " failed\n";
    return passed > 0 && failed == 0 ? 0 : 1;
}
