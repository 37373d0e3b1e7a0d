#include "cimserver/model/principal.h"

#include <utility>

namespace cimserver
{
namespace
{

thread_local Shared<std::string> user_of_thread = std::string("root");

} // namespace

Principal_Scope::Principal_Scope(std::string user) : _before(std::exchange(user_of_thread, Shared(std::move(user)))) {}

Principal_Scope::~Principal_Scope() { user_of_thread = std::move(_before); }

const Shared<std::string>& Principal_Scope::current() { return user_of_thread; }

} // namespace cimserver
