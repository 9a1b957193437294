// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "platform/com/Server.h"

namespace com {

/// Base of a component object: counts its references, keeps the server loaded while it lives, and
/// answers to the interfaces that it is told. Its destructor stands behind the last slot of
/// `Interface`, so the order of the slots is that of the interface.
template <class Interface>
class Counted : public Interface {
public:
    Status QueryInterface(const Guid& iid, void** object) final {
        if (!object) return Pointer;
        *object = nullptr;
        for (const Guid& known : known_) {
            if (!(known == iid)) continue;
            AddRef();
            *object = static_cast<Interface*>(this);
            return Ok;
        }
        return NoInterface;
    }
    quint32 AddRef() final { return ++references_; }
    quint32 Release() final {
        const quint32 left = --references_;
        if (left == 0) delete this;
        return left;
    }

protected:
    /// Starts with one reference.
    explicit Counted(std::vector<Guid> known) : known_(std::move(known)) { ++serverUse(); }
    virtual ~Counted() { --serverUse(); }

private:
    std::vector<Guid> known_;
    std::atomic<quint32> references_ = 1;
};

}  // namespace com
