#include "cimserver/model/principal.h"

#include <utility>

namespace cimserver
{
namespace
{

thread_local Text user_of_thread = "root";

} // namespace

Principal_Scope::Principal_Scope(std::string user) : _before(std::exchange(user_of_thread, Text(user))) {}

Principal_Scope::~Principal_Scope() { user_of_thread = std::move(_before); }

const Text& Principal_Scope::current() { return user_of_thread; }

} // namespace cimserver
