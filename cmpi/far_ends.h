// The far ends that an answer holds already: no two of one class, name space and keys. It keeps them alive, so that an instance
// which many associations share is known by its address alone.
#pragma once

#include "runtime/instance.h"
#include "runtime/model_path.h"

#include <cstddef>
#include <functional>
#include <string_view>
#include <unordered_set>

namespace zmlr
{

class Far_Ends
{
public:
    // False when the answer holds it already.
    bool add(Instance* far_end)
    {
        if (_shared.contains(far_end))
            return false;
        ref(far_end);
        const bool is_new = _named.emplace(far_end).second;
        if (is_new)
            _shared.insert(far_end);
        return is_new;
    }

private:
    struct Hash
    {
        std::size_t operator()(const Ref<Instance>& far_end) const
        {
            String text;
            instance_to_model_path(far_end.ptr(), text);
            return std::hash<std::string_view>()({text.c_str(), text.size()});
        }
    };
    struct Same
    {
        bool operator()(const Ref<Instance>& a, const Ref<Instance>& b) const
        {
            return a->meta_class == b->meta_class && a->__name_space == b->__name_space && key_eq(a.ptr(), b.ptr());
        }
    };

    std::unordered_set<const Instance*> _shared;
    std::unordered_set<Ref<Instance>, Hash, Same> _named;
};

} // namespace zmlr
