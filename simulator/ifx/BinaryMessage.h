#pragma once

#include "plist/BinaryObjects.h"
#include "simulator/ifx/Words.h"
#include "text/GrowingText.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::ifx {

/// Writes a message in the binary form without building an object. First come all words, then
/// the other texts, and each container after what it holds.
class BinaryMessage {
public:
    BinaryMessage();

    void beginDictionary() { begin(); }
    void endDictionary() { end(binary_form::kDictionary); }
    void emptyDictionary();
    void beginArray() { begin(); }
    void endArray() { end(binary_form::kArray); }
    void key(Word word) { _keys.put(referenceTo(word.number())); }
    void text(Word word) { _values.put(referenceTo(word.number())); }
    void text(const std::string& ascii);
    /// The message, after which nothing more can be told. More than 256 objects, to which one
    /// byte could not refer, throw std::length_error.
    std::string_view finish();

private:
    struct Begin {
        std::size_t key;
        std::size_t value;
    };

    static constexpr std::size_t kWaiting = 32; // grown for more

    void begin() { _open.push_back({_keys.size(), _values.size()}); }
    void end(binary_form::Kind kind);
    static char referenceTo(std::size_t object) { return static_cast<char>(object); }
    std::size_t last() const { return _objects.count() - 1; }

    binary_form::Objects _objects;
    // References that wait for the end of their container.
    GrowingText _keys{kWaiting};
    GrowingText _values{kWaiting}; ///< and elements
    std::vector<Begin> _open;      ///< where those of each open container begin
};

} // namespace pallax::ifx
