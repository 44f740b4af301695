// The cost of one message of the object stream: reading it, and building its display form, which
// the generator does only when a display is needed.

#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "plist/PropertyListCodec.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/TextPropertyList.h"

#include <benchmark/benchmark.h>

#include <cstdint>
#include <string>

namespace pallax {
namespace {

constexpr int kNeighbours = 32;

PropertyList cell(int number) {
    return Dictionary{
        {"ARFCN", std::to_string(number)},
        {"BSIC", std::to_string(number % 8) + "," + std::to_string(number / 8 % 8)},
        {"Rx Level", Dictionary{{"Value", std::to_string(-60 - number) + " dBm"}}},
        {"Area", Dictionary{{"LAC", "6699"}, {"Cell ID", std::to_string(20000 + number)}}},
    };
}

/// A serving cell and a full list of neighbours, with and without dictionaries of one entry.
PropertyList picture() {
    Array neighbours = {"header"};
    for (int number = 1; number <= kNeighbours; ++number) {
        neighbours.push_back(cell(number));
    }
    return Dictionary{
        {"RR", Dictionary{{"State", Dictionary{{"Name", "Dedicated"}}}}},
        {"Serving Cell", cell(0)},
        {"Neighbour Cells", std::move(neighbours)},
    };
}

/// A message to the generator, up to the state.
void update(benchmark::State& state, const ByteBuffer& message) {
    doubles::GeneratorFixture fixture;
    const auto generator = GSMLogGenerator::generator(fixture.environment());
    Dictionary display;
    for ([[maybe_unused]] const auto turn : state) {
        generator->updateState(display, message);
        benchmark::ClobberMemory();
    }
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(message.size()));
    state.SetItemsProcessed(state.iterations());
}

void updateXml(benchmark::State& state) {
    const std::string xml = *serializeXml(picture());
    update(state, {xml.begin(), xml.end()});
}
BENCHMARK(updateXml);

void updateBinary(benchmark::State& state) {
    update(state, *serializeBinary(picture()));
}
BENCHMARK(updateBinary);

void updateText(benchmark::State& state) {
    const std::string text = doubles::textForm(picture());
    update(state, {text.begin(), text.end()});
}
BENCHMARK(updateText);

/// Only the display form of an object that has been read.
void processObject(benchmark::State& state) {
    const PropertyList object = picture();
    for ([[maybe_unused]] const auto turn : state) {
        benchmark::DoNotOptimize(GSMLogGenerator::processObject(object));
    }
    state.SetItemsProcessed(state.iterations());
}
BENCHMARK(processObject);

} // namespace
} // namespace pallax
