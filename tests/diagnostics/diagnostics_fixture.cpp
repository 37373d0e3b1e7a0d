#include "tests/diagnostics/diagnostics_fixture.h"

#include "tests/runtime/resources.h"
#include "tests/support/temporary_folder.h"

#include <fstream>
#include <poll.h>
#include <regex>

namespace
{

constexpr const char* host = R"({"adapters": [
    {"kind": "cna",    "ports": [{}, {"state": "disabled"}]},
    {"kind": "fc-hba", "ports": [{}, {"state": "disabled"}]},
    {"kind": "cna",    "ports": [{"ioc_state": "disabled"}, {"ioc_state": "disabled"}]},
    {"kind": "fc-hba", "ports": [{"ioc_state": "disabled"}, {"ioc_state": "disabled"}]}]})";

struct Loaded
{
    cimserver::Module module{ZMLR_MODULE_PATH};
    cimserver::Server_Name_Spaces name_spaces{module};
};

std::unique_ptr<Loaded> loaded;

// A sanitizer has one of its own, from the program's first thread on. One that was joined may be listed a moment longer.
const std::size_t idle_threads = []
{
    std::thread([] {}).join();
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    return sample::Resources().threads;
}();

cimserver::Operations& operations() { return loaded->name_spaces.at("root/zemlar", ""); }

const Temporary_Folder& home()
{
    static const Temporary_Folder folder;
    return folder;
}

std::string text_of(const cimserver::Value& value)
{
    if (const auto* text = value.as<cimserver::Text>())
        return *text;
    const auto* number = value.as<std::uint64_t>();
    return number ? std::to_string(*number) : "";
}

} // namespace

void Diagnostics::load()
{
    if (loaded)
        return;
    static const bool first = []
    {
        if (wants_log)
            home().file(".cimplerc", "LOG_LEVEL=DBG\n");
        setenv("HOME", home().path("").c_str(), 1);
        hxasim::load_text(host);
        return true;
    }();
    static_cast<void>(first);
    loaded = std::make_unique<Loaded>();
}

void Diagnostics::unload() { loaded.reset(); }

void Diagnostics::SetUp()
{
    load();
    hxasim::set_time_scale(0);
    hxasim::take_requests();
    new_log();
}

void Diagnostics::TearDown()
{
    wait_for_end();
    hxasim::clear_faults();
    EXPECT_THAT(hxasim::violations(), testing::IsEmpty());
    unload();
}

std::vector<cimserver::Instance> Diagnostics::enumerate(const std::string& class_name)
{
    return operations().enumerate_instances(class_name, true, std::nullopt);
}

std::string Diagnostics::value(const cimserver::Instance& instance, const std::string& property)
{
    for (const auto& [name, value] : instance.properties)
        if (name == property)
            return text_of(value);
    return "";
}

cimserver::Object_Path Diagnostics::path(const std::string& class_name, std::size_t index)
{
    return enumerate(class_name).at(index).path;
}

Diagnostics::Answer Diagnostics::run(const std::string& test_class, const std::string& name,
                                     const cimserver::Object_Path& element)
{
    cimserver::Object_Path test = path(test_class, 0);
    cimserver::put(test.keys, "Name", {CMPI_string, "Zemlar:" + name});
    const cimserver::Value reference{CMPI_ref, element};
    const auto result = operations().invoke_method(test, "RunDiagnostic", {{"ManagedElement", reference}});
    Answer answer{text_of(result.return_value), ""};
    for (const auto& [parameter, value] : result.out)
        answer.job = text_of(value.as<cimserver::Object_Path>()->keys.at(0).value);
    return answer;
}

void Diagnostics::wait_for_end()
{
    for (int i = 0; i < 60'000 && sample::Resources().threads > idle_threads; ++i)
        ::poll(nullptr, 0, 1); // 1 ms that the simulator neither shortens nor counts
}

std::string Diagnostics::states()
{
    std::string text;
    for (const char* class_name : {"ZEMLAR_PortController", "ZEMLAR_FCPort", "ZEMLAR_EthernetPort"})
        for (const auto& instance : enumerate(class_name))
            text += value(instance, "DeviceID") + ' ' + value(instance, "EnabledState") + '\n';
    return text;
}

std::vector<std::string> Diagnostics::new_log()
{
    static std::ifstream messages;
    if (!messages.is_open())
        messages.open(home().path(".cimple/messages"));
    messages.clear();
    static const std::regex form(R"(\S+ \S+ (\w+): DiagnosticHelper\(\d+\): (.*))");
    std::vector<std::string> lines;
    std::smatch part;
    for (std::string line; std::getline(messages, line);)
        if (std::regex_match(line, part, form) && !part[2].str().starts_with("Requested Class") &&
            (part[1] != "DBG" || part[2] == "Entering: updateJobState")) // the job completes
            lines.push_back(part[1].str() + ' ' + part[2].str());
    return lines;
}
