#pragma once

class QMainWindow;

namespace kdx {

class PageTabs;

/// Gives the window the size it was designed for, which is its least one too; with a font larger than the designed
/// one, the size that its layouts need.
void fitToFont(QMainWindow& window, PageTabs& pages);

}  // namespace kdx
