#pragma once

// Handles of the window stand-in are the addresses of the objects behind them, but an address is only
// followed once the table has vouched for it: a stale or foreign handle is refused, never dereferenced.

#include <memory>
#include <unordered_map>
#include <vector>

namespace Pigmo::Platform::Ui {

template <typename Object>
class HandleTable {
public:
    template <typename Handle>
    Handle Add(std::shared_ptr<Object> object) {
        Object* address = object.get();
        objects_.emplace(address, std::move(object));
        return reinterpret_cast<Handle>(address);
    }

    template <typename Handle>
    Object* Find(Handle handle) const {
        const auto found = objects_.find(static_cast<const void*>(handle));
        return found != objects_.end() ? found->second.get() : nullptr;
    }

    template <typename Handle>
    std::shared_ptr<Object> Share(Handle handle) const {
        const auto found = objects_.find(static_cast<const void*>(handle));
        return found != objects_.end() ? found->second : nullptr;
    }

    // The object leaves the table; it lives on while someone still shares it.
    template <typename Handle>
    bool Remove(Handle handle) {
        return objects_.erase(static_cast<const void*>(handle)) != 0;
    }

    // A copy, so the caller may add and remove while it walks.
    std::vector<std::shared_ptr<Object>> Snapshot() const {
        std::vector<std::shared_ptr<Object>> all;
        all.reserve(objects_.size());
        for (const auto& [address, object] : objects_) all.push_back(object);
        return all;
    }

private:
    std::unordered_map<const void*, std::shared_ptr<Object>> objects_;
};

}  // namespace Pigmo::Platform::Ui
