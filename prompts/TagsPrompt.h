// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/NavigationController.h"
#include "kit/views/ListViewDataSource.h"
#include "kit/views/ListViewDelegate.h"
#include "kit/views/TextFieldDelegate.h"
#include "prompts/TagChoices.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace kit {
class ListView;
class TextField;
} // namespace kit

namespace tarrow {

/// Asks which tags items shall have: a field for a new name above a list of the known tags, of which those
/// that all items have are checked. Main thread only.
class TagsPrompt : public kit::ViewController,
                   public kit::ListViewDataSource,
                   public kit::ListViewDelegate,
                   public kit::TextFieldDelegate {
public:
    /// Called once, when the user has pressed Done and something is to be changed.
    using Chosen = std::function<void(const TagEdit& edit)>;

    /// Shows the prompt over a screen. `tagsOfItems` has the tags of each item.
    static std::shared_ptr<TagsPrompt> present(const std::shared_ptr<kit::ViewController>& parent,
        std::vector<std::vector<std::string>> tagsOfItems, Chosen chosen);
    TagsPrompt(TagChoices choices, Chosen chosen);

    const TagChoices& choices() const { return _choices; }
    const std::shared_ptr<kit::TextField>& nameField() const { return _nameField; } ///< null: not loaded
    const std::shared_ptr<kit::ListView>& listView() const { return _listView; } ///< null: not loaded

    void loadView() override;
    void viewDidLoad() override;

    std::size_t numberOfRows(const kit::ListView& list) const override;
    kit::ListRow rowAtIndex(const kit::ListView& list, std::size_t index) const override;
    kit::RowId rowIdAtIndex(const kit::ListView& list, std::size_t index) const override;
    void selectionDidChange(kit::ListView& list) override;
    bool textFieldShouldReturn(kit::TextField& field) override;

private:
    std::shared_ptr<TagsPrompt> self();
    void addTyped();
    void showSelection();
    void done();

    TagChoices _choices;
    Chosen _chosen;
    std::shared_ptr<kit::TextField> _nameField;
    std::shared_ptr<kit::ListView> _listView;
};

} // namespace tarrow
