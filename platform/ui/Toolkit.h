#pragma once

#include "platform/ui/Geometry.h"
#include "platform/ui/TextMetrics.h"
#include "platform/ui/Views.h"

#include <memory>
#include <string_view>

namespace pallax::ui {

class NavigationStack;
class ScreenView;
class TableScreen;
class TableSource;
class TableView;
class TextField;
class Window;

/// The parts of a modal screen's layout.
struct ModalOutlets {
    std::unique_ptr<TableView> list;
    std::unique_ptr<TextField> field;
};

/// A front end, as the controllers see it. It outlives all that it makes.
///
/// The roles that a screen gives back (`view()`, `table()`, `list()`, `field()`) are the objects
/// that its toolkit made, so the front end may cast them to its own classes. A table knows its
/// source from the start.
class Toolkit {
public:
    virtual ~Toolkit() = default;
    virtual const TextMetrics& textMetrics() const = 0;
    virtual Rect screenBounds() const = 0;
    /// The screen without the area of system elements such as a status bar.
    virtual Rect applicationFrame() const = 0;

    virtual std::unique_ptr<Window> makeWindow(const Rect& bounds) = 0;
    virtual std::unique_ptr<NavigationStack>
    makeNavigationStack(std::shared_ptr<TableScreen> root) = 0;
    virtual std::unique_ptr<ScreenView> makeScreenView() = 0;
    /// `source` is only stored, not called: its owner is still being constructed.
    virtual std::unique_ptr<TableView> makeTableView(TableSource& source) = 0;
    /// Lays out a modal screen by the name of its interface resource.
    virtual ModalOutlets loadLayout(std::string_view name, TableSource& source) = 0;
    virtual void showAlert(const Alert& alert) = 0;
};

} // namespace pallax::ui
