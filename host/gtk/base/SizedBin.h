// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/CanvasWidget.h"
#include "host/gtk/base/ObjectRef.h"

#include <functional>

namespace host::gtk {

/// A widget around one child that reports its size before the child is laid out in it.
class SizedBin : public CanvasClient {
public:
    using ResizeHandler = std::function<void(platform::Size)>;

    explicit SizedBin(ResizeHandler onResize);
    ~SizedBin() override;
    SizedBin(const SizedBin&) = delete;
    SizedBin& operator=(const SizedBin&) = delete;

    GtkWidget* widget() const { return _canvas.get(); }
    void setChild(GtkWidget* child);
    /// Answers the size as of the last layout, or zero before the first one.
    platform::Size size() const { return _size; }

    platform::Size canvasNaturalSize(double forWidth) override;
    void canvasAllocate(int width, int height) override;
    void canvasSnapshot(GtkSnapshot* snapshot) override;
    bool canvasContains(double x, double y) override;

private:
    ObjectRef<GtkWidget> _canvas, _child;
    ResizeHandler _onResize;
    platform::Size _size;
};

} // namespace host::gtk
