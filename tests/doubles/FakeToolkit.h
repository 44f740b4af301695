#pragma once

#include "platform/ui/Toolkit.h"
#include "tests/doubles/FakeNavigation.h"
#include "tests/doubles/FakeTextMetrics.h"
#include "tests/doubles/FakeViews.h"

#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace pallax::doubles {

/// A toolkit that draws nothing. All its objects record their calls in one diary, each screen and
/// table by its number in the order of creation ("screen 1", "table 1").
class FakeToolkit final : public ui::Toolkit {
public:
    FakeTextMetrics metrics;
    ScreenDiary diary;
    std::vector<ui::Alert> alerts;
    FakeNavigationStack* stack = nullptr; ///< the latest that was made
    ui::Rect bounds{{0, 0}, {320, 480}};
    ui::Rect applicationArea{{0, 20}, {320, 460}};

    const ui::TextMetrics& textMetrics() const override { return metrics; }
    ui::Rect screenBounds() const override { return bounds; }
    ui::Rect applicationFrame() const override { return applicationArea; }

    std::unique_ptr<ui::Window> makeWindow(const ui::Rect& frame) override {
        diary.push_back("make window " + rectText(frame));
        return std::make_unique<FakeWindow>(diary);
    }
    std::unique_ptr<ui::NavigationStack>
    makeNavigationStack(std::shared_ptr<ui::TableScreen> root) override {
        diary.emplace_back("make stack");
        auto madeStack = std::make_unique<FakeNavigationStack>(diary, std::move(root));
        stack = madeStack.get();
        return madeStack;
    }
    std::unique_ptr<ui::ScreenView> makeScreenView() override {
        return std::make_unique<FakeScreenView>(diary, made("screen", ++_screens));
    }
    std::unique_ptr<ui::TableView> makeTableView(ui::TableSource& source) override {
        return std::make_unique<FakeTableView>(diary, made("table", ++_tables), source);
    }
    ui::ModalOutlets loadLayout(std::string_view name, ui::TableSource& source) override {
        diary.push_back("load layout " + std::string(name));
        return {std::make_unique<FakeTableView>(diary, "list", source),
                std::make_unique<FakeTextField>(diary)};
    }
    void showAlert(const ui::Alert& alert) override {
        diary.push_back("alert " + alert.title);
        alerts.push_back(alert);
    }

    /// The entries since the last call.
    ScreenDiary take() { return std::exchange(diary, {}); }

private:
    std::string made(const std::string& kind, int number) {
        std::string name = kind + " " + std::to_string(number);
        diary.push_back("make " + name);
        return name;
    }

    int _screens = 0;
    int _tables = 0;
};

} // namespace pallax::doubles
