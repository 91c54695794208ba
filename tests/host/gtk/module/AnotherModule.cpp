// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

/// Does nothing. It stands for a function in a module of another program.
extern "C" void anotherModule();
extern "C" void anotherModule() { }
