#pragma once

#include "app/PallaxCell.h"
#include "app/PallaxPaneController.h"
#include "tests/app/pane/PaneNodes.h"
#include "tests/doubles/FakeToolkit.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <utility>

namespace pallax::doubles {

/// An application object whose answers are set by the test.
class FakePaneApplication final : public PaneApplication {
public:
    bool saveAllowed = false;
    int saveViewsAsked = 0;
    std::unique_ptr<FakeNavigationStack> stack;

    bool allowSaveButton() const override { return saveAllowed; }
    void showSaveView() override { ++saveViewsAsked; }
    ui::NavigationStack* navigationController() override { return stack.get(); }
};

/// Panes in a fake toolkit, without a model.
class PaneFixture : public testing::Test {
protected:
    using PaneRef = std::shared_ptr<PallaxPaneController>;

    PaneRef makePane(NodeRef node, std::string path = "/") {
        return std::make_shared<PallaxPaneController>(toolkit, application, std::move(node),
                                                      std::move(path));
    }
    /// Puts the pane on a stack as its root.
    void putOnStack(PaneRef pane) {
        application.stack = std::make_unique<FakeNavigationStack>(toolkit.diary, std::move(pane));
    }
    static FakeTableView& tableOf(PallaxPaneController& pane) {
        return dynamic_cast<FakeTableView&>(pane.table());
    }
    static std::shared_ptr<PallaxCell> cellOf(PallaxPaneController& pane, std::size_t row) {
        return std::dynamic_pointer_cast<PallaxCell>(pane.cellForRow(row));
    }
    static const ui::ActivityIndicator& spinnerOf(const ui::Screen& screen) {
        return std::get<ui::ActivityIndicator>(screen.toolbarItems().at(0));
    }
    static const ui::Label& statusOf(const ui::Screen& screen) {
        return std::get<ui::Label>(screen.toolbarItems().at(1));
    }

    FakeToolkit toolkit;
    FakePaneApplication application;
};

} // namespace pallax::doubles
