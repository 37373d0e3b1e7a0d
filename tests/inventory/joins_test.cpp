// The rows that join instances: which requests they cost, what they say of a side that is empty, and what their rules make of
// keys that no adapter of ours has.
#include "hxal/hxal.h"
#include "inventory/adapter_lookup.h"
#include "providers/joining.h"
#include "providers/joins.h"
#include "tests/inventory/inventory_fixture.h"

#include <algorithm>
#include <fstream>
#include <set>
#include <span>
#include <sstream>

using namespace zmlr;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{

using Texts = std::vector<std::string>;

// What tells an instance from others of its class.
std::string name_of(const Instance* instance)
{
    for (const char* key : {"Tag", "DeviceID", "InstanceID", "Name"})
    {
        const Meta_Property* property = find_property(instance->meta_class, key);
        if (property && is_key(property))
            return static_cast<const String*>(address_of(instance, property->offset))->c_str();
    }
    return {};
}

// The associations, each as the names of what it joins.
Texts joined(const Join& row, std::size_t enough = 1000)
{
    Texts texts;
    const auto take = [&](Instance* association)
    {
        const Ref<Instance> owned(association);
        std::string text;
        for (uint32 i = 0; i < association->meta_class->num_meta_features; i++)
        {
            const Meta_Feature* feature = association->meta_class->meta_features[i];
            if (is_reference(feature))
                text += (text.empty() ? "" : " ") + name_of(reference_of(association, as_reference(feature)));
        }
        texts.push_back(text);
        return texts.size() < enough;
    };
    Joining joining(row, "Test_Provider", take);
    row.match(joining);
    return texts;
}

// What is asked for in the tests' own rows.
std::vector<Ref<Instance>> sides[max_sides];

template <int i> Instance_Array given(const Inventory_Request&)
{
    Instance_Array instances;
    for (const Ref<Instance>& instance : sides[i])
        instances.adopt(instance);
    return instances;
}

template <int i> Instance_Array given_to(const Instance*, const Inventory_Request& request) { return given<i>(request); }

// Gives a side as many elements as it needs, and more where it may have them.
void give_side(const Join& row, std::size_t side, std::size_t count)
{
    sides[side].clear();
    const char* const names[] = {"FC HBA", "Server", "SMI-S"};
    for (std::size_t i = 0; i < count; i++)
    {
        Instance* element = create(row.sides[side].meta_class, true);
        sides[side].emplace_back(element);
        if (element->meta_class == &ZEMLAR_RegisteredProfile::static_meta_class)
            static_cast<ZEMLAR_RegisteredProfile*>(element)->RegisteredName.set(names[i]);
    }
}

void give_side(const Join& row, std::size_t side) { give_side(row, side, row.sides[side].need == Need::exactly_one ? 1 : 3); }

// The row, with sides that are given.
Join with_given_sides(Join row)
{
    constexpr decltype(Side::ask) asks[] = {given<0>, given<1>, given<2>, given<3>};
    constexpr decltype(Side::ask_of) asks_of[] = {given_to<0>, given_to<1>, given_to<2>, given_to<3>};
    for (std::size_t side = 0; side < max_sides && row.sides[side].meta_class; side++)
    {
        row.sides[side].ask = asks[side];
        if (row.sides[side].ask_of)
            row.sides[side].ask_of = asks_of[side];
        give_side(row, side);
    }
    return row;
}

template <class T> void give(int i, Property<String> T::*key, std::initializer_list<const char*> texts)
{
    sides[i].clear();
    for (const char* text : texts)
    {
        T* instance = T::create();
        sides[i].emplace_back(instance);
        if (text)
            (instance->*key).set(text);
    }
    sides[i].emplace_back();
    sides[i].emplace_back(ZEMLAR_ComputerSystem::create());
}

class Joins : public Inventory_Test
{
protected:
    static Instance_Array all_instances_of(const Meta_Class* meta_class)
    {
        const auto* row = std::ranges::find(enumerations, meta_class, &Enumeration::meta_class);
        return row == std::end(enumerations) ? Instance_Array() : row->get_instances(row->id, {});
    }

    Texts requests_for_addresses_of_adapters_with_connectors()
    {
        std::set<int> adapters; // whose index is the last but one part of a tag
        for (const std::string& tag : values_of(all_instances_of(&ZEMLAR_PhysicalConnector::static_meta_class), "Tag"))
            adapters.insert(std::stoi(tag.substr(tag.rfind('_', tag.rfind('_') - 1) + 1)));
        requests();
        for (const int adapter : adapters)
            ProviderUtil::getAddrByAdapterId(adapter);
        return requests();
    }

    // How many associations a row makes, and what it logs.
    std::string said_by(const Join& row)
    {
        log();
        std::string text = std::to_string(joined(row).size()) + '\n';
        for (const std::string& line : log())
            if (line.find(" Test_Provider: ") != line.npos)
                text += '|' + line + "|\n";
        return text;
    }
};

} // namespace

TEST_F(Joins, cost_the_requests_of_their_sides)
{
    for (const char* scenario : {"fc-hba", "cna", "mixed", "odd"})
    {
        hxasim::load(scenario);
        hxal_adapter_scan();
        std::vector<Join> rows(std::begin(inventory_joins), std::end(inventory_joins));
        rows.insert(rows.end(), std::begin(diagnostic_joins), std::end(diagnostic_joins));
        for (const Join& row : rows)
        {
            SCOPED_TRACE(std::string(scenario) + ' ' + row.meta_class->name);
            requests();
            const bool is_without_units = joined(row).empty() && row.match == paths_to_units;
            Texts sent = requests();
            for (const Side& side : row.sides)
                if (side.meta_class && !(is_without_units && side.meta_class == &ZEMLAR_SCSIProtocolEndpoint::static_meta_class))
                    all_instances_of(side.meta_class); // the ports of all adapters are all ports
            Texts expected = requests();
            if (row.match == connectors_in_packages)
            {
                const Texts asked = requests_for_addresses_of_adapters_with_connectors();
                expected.insert(expected.end(), asked.begin(), asked.end());
            }
            std::ranges::sort(sent);
            std::ranges::sort(expected);
            EXPECT_EQ(sent, expected);
        }
    }
}

TEST_F(Joins, end_when_the_client_has_enough)
{
    for (const Join& row : inventory_joins)
    {
        const Texts all = joined(row);
        EXPECT_EQ(joined(row, 1), Texts(all.begin(), all.begin() + (all.empty() ? 0 : 1))) << row.meta_class->name;
    }
}

// The file holds for each row how many associations it makes of the elements given and what it logs; then the same without the
// elements of each side in turn, and with another number of them, where that changes what it logs. In bars.
TEST_F(Joins, say_what_is_missing)
{
    std::ostringstream said;
    for (const std::span<const Join> rows : {std::span<const Join>(inventory_joins), {profile_joins}, {diagnostic_joins}})
    {
        for (const Join& row : rows)
        {
            const Join given_row = with_given_sides(row);
            const std::string with_all = said_by(given_row);
            said << row.meta_class->name << ": " << with_all;
            for (std::size_t side = 0; side < max_sides && row.sides[side].meta_class; side++)
            {
                for (const std::size_t count : {0U, 2U})
                {
                    give_side(row, side, count);
                    const std::string without = said_by(given_row);
                    if (without.substr(without.find('\n')) != with_all.substr(with_all.find('\n')))
                        said << "- " << count << ' ' << row.sides[side].meta_class->name << ": " << without;
                }
                give_side(row, side);
            }
        }
    }
    std::ostringstream expected;
    expected << std::ifstream(JOINS_FILE).rdbuf();
    EXPECT_EQ(said.str(), expected.str());
}

TEST_F(Joins, need_one_service_and_take_its_capabilities)
{
    using Capabilities = ZEMLAR_HBASoftwareInstallationServiceElementCapabilities;
    constexpr Join row = join(same_positions, exactly_one(side<&Capabilities::ManagedElement>({LL_ERR, "no service"}, given<0>)),
                              side<&Capabilities::Capabilities>({LL_ERR, "no capabilities"}, given<1>));
    give(0, &ZEMLAR_HBASoftwareInstallationService::Name, {"service"});
    give(1, &ZEMLAR_HBASoftwareInstallationServiceCapabilities::InstanceID, {"first", "second"});
    EXPECT_THAT(joined(row), IsEmpty());
    EXPECT_THAT(log(), ElementsAre("ERR Test_Provider: no service")) << "or several";
    sides[0].resize(1);
    EXPECT_THAT(joined(row), ElementsAre("service first"));
}

TEST_F(Joins, match_keys_without_regard_to_case_and_nothing_by_an_empty_one)
{
    constexpr Join row =
        join(equal_keys, side<&ZEMLAR_ProductElementComponent::PartComponent, &ZEMLAR_PortController::DeviceID>({}, given<0>),
             side<&ZEMLAR_ProductElementComponent::GroupComponent, &ZEMLAR_Product::Name>({}, given<1>));
    give(0, &ZEMLAR_PortController::DeviceID, {"b", "", "A", "c", nullptr, "a"});
    give(1, &ZEMLAR_Product::Name, {"A", "", "B", nullptr, "a", "AA"});
    EXPECT_THAT(joined(row), ElementsAre("B b", "A A", "a A", "A a", "a a"));
}

TEST_F(Joins, tie_software_to_its_adapter_and_drivers_to_all)
{
    using Software = ZEMLAR_AdapterElementSoftwareIdentity;
    constexpr Join row =
        join(software_on_controllers, side<&Software::Antecedent>({}, given<0>), side<&Software::Dependent>({}, given<1>));
    const std::string longest(63, 'L');
    give(
        0, &ZEMLAR_AdapterSoftwareIdentity::InstanceID,
        {"hxn", "hx", "aaaa_firmware", "_bios", "", "BBBB", "stranger_bios", (longest + "L_bios").c_str(), "HXA_x", "bbbb_bios"});
    for (const std::size_t driver : {0U, 1U, 8U})
        static_cast<ZEMLAR_AdapterSoftwareIdentity*>(sides[0][driver].ptr())->Classifications.set({10, 2});
    give(1, &ZEMLAR_PortController::DeviceID, {"AAAA", "BBBB", longest.c_str(), ""});
    static_cast<ZEMLAR_PortController*>(sides[1][1].ptr())->ControllerType.set(4);
    EXPECT_THAT(joined(row), ElementsAre("hxn AAAA", "hx AAAA", "aaaa_firmware AAAA", "HXA_x AAAA", "hx BBBB", "BBBB BBBB",
                                         "HXA_x BBBB", "bbbb_bios BBBB", "hxn " + longest, "hx " + longest,
                                         longest + "L_bios " + longest, "HXA_x " + longest, "hxn ", "hx ", "HXA_x "));
    const Texts said = log();
    EXPECT_EQ(std::ranges::count(said, "INFO Test_Provider: No MAC or NWWN returned from strtok function"), 2 * 4);
}

TEST_F(Joins, read_tags_from_their_end)
{
    constexpr Join in_packages =
        join(connectors_in_packages, side<&ZEMLAR_PhysicalConnectorContainer::PartComponent>({}, given<0>),
             side<&ZEMLAR_PhysicalConnectorContainer::GroupComponent, address_in_tag>());
    constexpr Join at_ports = join(ports_at_connectors, side<&ZEMLAR_EthernetPortRealizes::Antecedent>({}, given<0>),
                                   of_each<ethernet_ports_beside>(side<&ZEMLAR_EthernetPortRealizes::Dependent>()));
    give(0, &ZEMLAR_PhysicalConnector::Tag,
         {"_2_1", "S_1_0", "A_B_9_1_1", "S_1_7", "S_1_0", "", "1_0", "_", "S__0", "S_1_", "S_1_-0", "S_1_0x", "S_x1_0", "S_0_0",
          "S_-1_0", "S_99_0", "S_99999999999_0", nullptr, "S_1_65536"});
    const std::string first = "10000000-0000-0000-0000-00051E300000 ";
    EXPECT_THAT(joined(in_packages), ElementsAre(first + "S_1_0", first + "A_B_9_1_1", first + "S_1_7", first + "S_1_0",
                                                 first + "S_1_65536", "10000000-0000-0000-2000-00051E100100 _2_1"));
    EXPECT_THAT(joined(at_ports), ElementsAre("S_1_0 00051E200000", "A_B_9_1_1 00051E200001", "S_1_0 00051E200000"));
}

TEST_F(Joins, find_the_path_to_a_unit_by_the_names_of_its_ends)
{
    using Path = ZEMLAR_SCSIInitiatorTargetLogicalUnitPath;
    constexpr Join row =
        join(paths_to_units,
             optional(side_of<ZEMLAR_StorageExtent, &Path::LogicalUnit, &ZEMLAR_StorageExtent::DeviceID>({}, given<0>)),
             optional(side_of<ZEMLAR_TapeDrive, &Path::LogicalUnit, &ZEMLAR_TapeDrive::DeviceID>({}, given<1>)),
             side<&Path::Initiator, &ZEMLAR_SCSIProtocolEndpoint::Name>({}, given<2>));
    sides[0].clear();
    give(1, &ZEMLAR_TapeDrive::DeviceID, {"I_t_LUN_0", "J_T_LUN_0", "I_U_LUN_0", "I", "", nullptr, "i_T_x"});
    give(2, &ZEMLAR_SCSIProtocolEndpoint::Name, {"I_T", "I", "J", "i", "", "_"});
    EXPECT_THAT(joined(row), ElementsAre("I I_T I_t_LUN_0", "I I_T i_T_x")) << "tapes without disks";
}
