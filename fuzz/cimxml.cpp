// Any bytes as a CIM-XML request, answered by operations that give back what they were given: what is no request is refused,
// everything else gets an answer that reads as CIM-XML again, whatever texts went into it.
#include "cimserver/cimxml/service.h"
#include "cimserver/cimxml/xml_tree.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <iterator>

namespace
{

using namespace cimserver;

constexpr zmlr::Meta_Property name_key{
    {{0}, zmlr::Flag_Property | zmlr::Flag_Read | zmlr::Flag_Key, "Name", nullptr, 0}, zmlr::STRING, 0, 0, nullptr};
constexpr const zmlr::Meta_Feature* features[] = {&name_key};
constexpr zmlr::Meta_Feature_Local locals[] = {{1}};
constexpr zmlr::Meta_Class some_class{
    {{{0}, zmlr::Flag_Class, "TST_Box", nullptr, 0}, features, std::size(features), 0}, locals, nullptr, 1, nullptr};

class Echo : public Operations, public Name_Spaces
{
public:
    Operations& at(const std::string&, const std::string&) override { return *this; }

    const zmlr::Meta_Class* get_class(const std::string&) override { return &some_class; }
    std::vector<const zmlr::Meta_Class*> enumerate_classes(const std::string&, bool) override { return {&some_class}; }
    std::vector<Object_Path> enumerate_instance_names(const std::string& class_name) override
    {
        return {{"", "root/test", class_name, {}}};
    }
    std::vector<Instance> enumerate_instances(const std::string& class_name, bool, const Property_List&) override
    {
        return {{{"", "root/test", class_name, {}}, {}}};
    }
    Instance get_instance(const Object_Path& path, const Property_List&) override { return {path, path.keys}; }
    Object_Path create_instance(const Instance& instance) override
    {
        return {"", "", instance.path.class_name, instance.properties};
    }
    void modify_instance(const Instance&, const Property_List&) override {}
    void delete_instance(const Object_Path& path) override { throw Cim_Error(CIM_ERR_NOT_FOUND, path.class_name); }
    std::vector<Instance> associators(const Object_Path& path, const Association_Filter&, const Property_List&) override
    {
        return {{path, path.keys}};
    }
    std::vector<Object_Path> associator_names(const Object_Path& path, const Association_Filter&) override { return {path}; }
    std::vector<Instance> references(const Object_Path& path, const Association_Filter& filter,
                                     const Property_List& list) override
    {
        return associators(path, filter, list);
    }
    std::vector<Object_Path> reference_names(const Object_Path& path, const Association_Filter&) override { return {path}; }
    Method_Result invoke_method(const Object_Path&, const std::string& method, const std::vector<Named_Value>& in) override
    {
        return {{CMPI_string, method}, in};
    }
};

// Aborts, which is a finding, when an answer cannot be read. One that echoes a large request may pass the reader's limits.
void check_answer(const std::string& text)
try
{
    const Xml_Element cim = read_xml(text);
    const Xml_Element* message = cim.child("MESSAGE");
    if (cim.name != "CIM" || !message || message->children.size() != 1 || message->children.front().name != "SIMPLERSP")
        std::abort();
}
catch (const Http_Refusal& refusal)
{
    if (refusal.cim_error() != "request-not-valid")
        std::abort();
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    Echo operations;
    const Http_Request request{"MethodCall", std::string(reinterpret_cast<const char*>(data), size)};
    const Http_Work work = Service(operations).handle(request);
    const Http_Answer answer = work.rest ? work.rest() : work.answer;
    if (answer.status == 200)
        check_answer(answer.body);
    else if (answer.cim_error.empty() || !answer.body.empty())
        std::abort();
    return 0;
}
