#pragma once

#include <atspi/atspi.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace e2e {

/// A node of the accessibility tree.
class Accessible {
public:
    Accessible() = default;
    /// Takes over a reference.
    explicit Accessible(AtspiAccessible* node);

    explicit operator bool() const { return _node != nullptr; }
    std::string name() const;
    /// Whether the node was there at the last look and is meant to be seen.
    bool isVisible() const;
    /// Performs the first action of the node; false when it has none.
    bool press() const;
    /// All visible nodes below that match, in the order of the tree. Of a long list only the first are looked
    /// at.
    std::vector<Accessible> all(const std::function<bool(const Accessible&)>& matches) const;
    bool isButton() const;
    bool isEntry() const;
    bool isDialog() const;
    /// Replaces the text of an entry; false when it takes none.
    bool enter(const std::string& text) const;

    /// The running application of this program name; null: it has not appeared.
    static Accessible application(const std::string& program);
    /// Lets messages through until a condition holds; false after twenty seconds.
    static bool waitFor(const std::function<bool()>& condition);

private:
    void collect(const std::function<bool(const Accessible&)>& matches, std::vector<Accessible>& found) const;

    std::shared_ptr<AtspiAccessible> _node;
};

} // namespace e2e
