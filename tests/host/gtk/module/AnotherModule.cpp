// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

/// Does nothing: what a module of something else would have.
extern "C" void anotherModule();
extern "C" void anotherModule() { }
