// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace kit {

class ActivityIndicator;
class Button;
class HostedView;
class ImageView;
class Label;
class ListView;
class ScrollView;
class TextField;
class View;

/// Tells the classes of views apart without casts: `view.accept(visitor)` calls the operation of the nearest
/// class. A view of a derived class is visited as its base class; stack views are visited as plain views.
class ViewVisitor {
public:
    virtual ~ViewVisitor() = default;

    virtual void visit(View& view) = 0;
    virtual void visit(Label& label) = 0;
    virtual void visit(ImageView& imageView) = 0;
    virtual void visit(Button& button) = 0;
    virtual void visit(TextField& textField) = 0;
    virtual void visit(ScrollView& scrollView) = 0;
    virtual void visit(ListView& listView) = 0;
    virtual void visit(ActivityIndicator& indicator) = 0;
    virtual void visit(HostedView& hostedView) = 0;
};

} // namespace kit
