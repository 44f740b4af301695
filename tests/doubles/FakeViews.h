#pragma once

#include "platform/ui/Screen.h"
#include "platform/ui/TableView.h"
#include "platform/ui/TextField.h"

#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace pallax::doubles {

/// The calls in order, shared by all objects of one toolkit.
using ScreenDiary = std::vector<std::string>;

/// "true" or "false", as in diaries.
inline std::string truth(bool value) {
    return value ? "true" : "false";
}

/// "(x y w h)" in whole points.
inline std::string rectText(const ui::Rect& rect) {
    const auto whole = [](double points) { return std::to_string(static_cast<int>(points)); };
    return "(" + whole(rect.origin.x) + " " + whole(rect.origin.y) + " " + whole(rect.size.width) +
           " " + whole(rect.size.height) + ")";
}

/// Records the calls of the toolkit's own handling: "NAME willAppear animated=true".
class FakeScreenView final : public ui::ScreenView {
public:
    FakeScreenView(ScreenDiary& diary, std::string name) : _diary(diary), _name(std::move(name)) {}

    void didLoad() override { note("didLoad"); }
    void willAppear(bool animated) override { note("willAppear animated=" + truth(animated)); }
    void willDisappear(bool animated) override {
        note("willDisappear animated=" + truth(animated));
    }
    void didReceiveMemoryWarning() override { note("didReceiveMemoryWarning"); }
    void didUnload() override { note("didUnload"); }
    void resignFirstResponder() override { note("resignFirstResponder"); }
    void setFrame(const ui::Rect& frame) override { note("setFrame " + rectText(frame)); }
    void titleChanged() override { note("titleChanged"); }
    void toolbarItemsChanged(bool animated) override {
        note("toolbarItemsChanged animated=" + truth(animated));
    }

private:
    void note(const std::string& what) { _diary.push_back(_name + " " + what); }

    ScreenDiary& _diary;
    std::string _name;
};

/// A table whose rows the test requests and whose spare cells it provides.
class FakeTableView final : public ui::TableView {
public:
    FakeTableView(ScreenDiary& diary, std::string name, ui::TableSource& tableSource)
        : source(tableSource), _diary(diary), _name(std::move(name)) {}

    ui::TableSource& source;
    ui::Rect bounds{{0, 0}, {320, 44}};
    std::vector<std::shared_ptr<ui::TableCell>> spare; ///< cells that have left the screen
    std::vector<std::string> dequeued;                 ///< the requested identifiers

    std::shared_ptr<ui::TableCell> dequeueReusableCell(std::string_view identifier) override {
        dequeued.emplace_back(identifier);
        for (auto cell = spare.begin(); cell != spare.end(); ++cell) {
            if ((*cell)->reuseIdentifier() == identifier) {
                auto found = std::move(*cell);
                spare.erase(cell);
                return found;
            }
        }
        return nullptr;
    }
    ui::Rect contentBounds() const override { return bounds; }
    void reloadData() override { note("reloadData"); }
    void deselectRow(std::size_t row, bool animated) override {
        note("deselectRow " + std::to_string(row) + " animated=" + truth(animated));
    }
    void sizeToFit() override { note("sizeToFit"); }

private:
    void note(const std::string& what) { _diary.push_back(_name + " " + what); }

    ScreenDiary& _diary;
    std::string _name;
};

/// A field with the text that the test types into it.
class FakeTextField final : public ui::TextField {
public:
    explicit FakeTextField(ScreenDiary& diary) : _diary(diary) {}

    std::string typed;
    ui::TextFieldDelegate* delegate = nullptr;

    std::string text() const override { return typed; }
    void setDelegate(ui::TextFieldDelegate* newDelegate) override {
        delegate = newDelegate;
        _diary.emplace_back("field setDelegate");
    }
    void resignFirstResponder() override { _diary.emplace_back("field resignFirstResponder"); }

private:
    ScreenDiary& _diary;
};

} // namespace pallax::doubles
