#pragma once

#include "tests/ui/drawing/GridSupport.h"
#include "tests/ui/terminal/StageData.h"
#include "tests/ui/terminal/TerminalStage.h"
#include "ui/curses/CursesKeys.h"

#include <array>
#include <cstdint>
#include <span>
#include <string>

namespace pallax::terminal {

/// Plays bytes as events of the front end: a byte below 0x80 is typed; others are keys, a resize,
/// new data, and so on (see `act`), some with arguments in the bytes that follow.
class StageScript {
public:
    explicit StageScript(std::span<const std::uint8_t> bytes) : _bytes(bytes) {
        _stage.saveHistory = snapshotItems();
        _stage.overview = anOverview();
        _stage.frontEnd.resize(kMostColumns / 2, kMostRows / 2);
    }

    /// The first fault, or "".
    std::string play() {
        std::string fault = check();
        while (fault.empty() && !_bytes.empty()) {
            const std::uint8_t code = next();
            act(code);
            // Sometimes several events happen before the next drawing.
            if (code != kNoDrawing) {
                fault = check();
            }
        }
        return fault;
    }

private:
    static constexpr std::uint8_t kNoDrawing = 0xFF;
    // Small, because every step draws a screen.
    static constexpr int kMostColumns = 64;
    static constexpr int kMostRows = 20;
    static constexpr auto kKeys = std::to_array<Key>(
        {Key::Enter, Key::Escape, Key::Backspace, Key::Delete, Key::Tab, Key::BackTab, Key::Up,
         Key::Down, Key::Left, Key::Right, Key::PageUp, Key::PageDown, Key::Home, Key::End});
    static constexpr auto kCharacters =
        std::to_array<char32_t>({U'漢', U'é', U'\u0301', U'\u200d', U'\U0001F600', 0x85, 0xD800});

    std::uint8_t next() {
        if (_bytes.empty()) {
            return 0;
        }
        const std::uint8_t byte = _bytes.front();
        _bytes = _bytes.subspan(1);
        return byte;
    }

    void act(std::uint8_t code) {
        constexpr std::uint8_t kFirstKey = 0x80;
        constexpr std::uint8_t kFirstCharacter = 0xA0;
        if (code < kFirstKey) {
            _stage.frontEnd.handle(keyOfCharacter(code));
        } else if (code < kFirstKey + kKeys.size()) {
            _stage.press(kKeys.at(code - kFirstKey));
        } else if (code >= kFirstCharacter && code < kFirstCharacter + kCharacters.size()) {
            _stage.frontEnd.handle(keyOfCharacter(kCharacters.at(code - kFirstCharacter)));
        } else {
            actBesideKeys(code);
        }
    }

    void actBesideKeys(std::uint8_t code) {
        switch (code) {
        case 0x90: {
            const int columns = next() % kMostColumns;
            return _stage.frontEnd.resize(columns, next() % kMostRows);
        }
        case 0x91:
            return _stage.tick(data(next()));
        case 0x92: {
            const int x = next() % kMostColumns;
            return _stage.mouse(Key::Click, x, next() % kMostRows);
        }
        case 0x9F: {
            const int x = next() % kMostColumns;
            return _stage.mouse(Key::Drag, x, next() % kMostRows);
        }
        case 0x93:
            return _stage.mouse(Key::WheelUp, 0, 0);
        case 0x94:
            return _stage.mouse(Key::WheelDown, 0, 0);
        case 0x95:
            return _stage.frontEnd.turn();
        case 0x96:
            return _stage.frontEnd.toolkit().showAlert({"漢字", "A long message\x1b[2J", "OK"});
        case 0x97:
            return _stage.frontEnd.setMessage("A message 漢字\xff");
        case 0x98:
            return _stage.frontEnd.setNote("A note");
        case 0x9B:
            return _stage.frontEnd.setOrigin({"Zorell_LTE", "漢字\xff.pcap"});
        case 0x9C:
            return _stage.frontEnd.setOldValues(next() % 2 == 0 ? "22:13:30" : "");
        case 0x9D:
            return _stage.frontEnd.setStream(next() % 2 == 0 ? "no data for 7 s" : "");
        case 0x9E:
            return _stage.frontEnd.setAlarms(std::vector<std::string>(next() % 4, "漢字\x1b"));
        case 0x99:
            return _stage.queue.runReady();
        case 0x9A:
            _stage.savingAllowed = !_stage.savingAllowed;
            return;
        default:
            return;
        }
    }

    /// More than most of the screens can show.
    static Overview anOverview() {
        constexpr int kMany = 20;
        Overview overview;
        overview.status.cells = {{"LTE",
                                  "漢字\x1b",
                                  {{"PCI", "", "\xff", 0, {}, {}}},
                                  {},
                                  "",
                                  {},
                                  {{"RSRP", "", "-92.25 dBm", 0, {}, {}}}}};
        for (int index = 0; index < kMany; ++index) {
            overview.status.neighbours.push_back(
                {"LTE", "PCI " + std::to_string(index), {"RSRP", "", "e\u0301", 0, {}, {}}});
            overview.events.push_back({EventKind::CellChange, {}, 1, "漢字 → \u009b", {}});
        }
        return overview;
    }

    /// Displays of several kinds, whose panes share names.
    static PropertyList data(std::uint8_t kind) {
        constexpr int kMany = 50;
        switch (kind % 6) {
        case 0:
            return {};
        case 1:
            return display();
        case 2:
            return display("-99.00 dBm");
        case 3:
            return Dictionary{{"SIM Info", Dictionary{{"漢字漢字漢字漢字漢字漢字漢字", "値"},
                                                      {"e\u0301\u0323", "\xff\x1b\u009b"},
                                                      {"IMSI", std::string(200, '1')}}}};
        case 4: {
            Dictionary rows;
            for (int row = 0; row < kMany; ++row) {
                rows.set(Text("Row " + std::to_string(row)), std::to_string(row * kind));
            }
            return Dictionary{{"Operator", "Example"}, {"Serving Cell Measurements", rows}};
        }
        default:
            return Dictionary{};
        }
    }

    std::string check() {
        const Grid grid = _stage.frontEnd.draw();
        const TerminalToolkit& toolkit = _stage.frontEnd.toolkit();
        if (grid.columns() != toolkit.columns() || grid.rows() != toolkit.rows()) {
            return "a grid of another extent than the terminal's";
        }
        if (const auto& cursor = grid.cursor()) {
            if (cursor->x < 0 || cursor->x >= grid.columns() || cursor->y < 0 ||
                cursor->y >= grid.rows()) {
                return "a cursor outside the screen";
            }
        }
        const PaneModel& pane = _stage.pane();
        if (pane.cursor() >= pane.shownRows() && pane.shownRows() > 0) {
            return "a cursor on no row";
        }
        if (_stage.table().firstShown() > pane.cursor()) {
            return "a cursor above the window";
        }
        return faultOf(grid);
    }

    std::span<const std::uint8_t> _bytes;
    TerminalStage _stage;
};

} // namespace pallax::terminal
