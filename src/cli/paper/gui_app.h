#pragma once
// The Qt application that fonts and painting need, made only by commands that draw. With no
// platform chosen, the offscreen one is used so that drawing works without a display.
namespace kori::cli {

void EnsureGuiApplication();

} // namespace kori::cli
