// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace kit {

class AlertController;
class NavigationController;
class SearchPresentation;
class ViewController;

/// Tells the classes of screens apart without casts.
class ViewControllerVisitor {
public:
    virtual ~ViewControllerVisitor() = default;

    virtual void visit(ViewController& controller) = 0;
    virtual void visit(NavigationController& controller) = 0;
    virtual void visit(AlertController& controller) = 0;
    virtual void visit(SearchPresentation& controller) = 0;
};

} // namespace kit
