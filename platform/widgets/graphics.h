// Graphics: the drawing surface that a Paint or CellBackgroundPaint event hands over.
// Outlines grow inward: a pen of n fills the n outermost pixels inside the given rectangle.
#pragma once

#include <string>

#include "platform/core/color.h"

class QPainter;

class Graphics {
  public:
    // Draws through `painter` on a surface of that size; `ground` is what ClearRect leaves.
    Graphics(QPainter& painter, int width, int height, Color ground);

    Color ForeColor = 0;
    double PenWidth = 1.0;
    double PenHeight = 1.0;
    // 0.0 is opaque, 100.0 invisible.
    double Transparency = 0.0;
    std::string TextFont;
    float TextSize = 0.0f;
    bool Bold = false;

    int Width() const { return width_; }
    int Height() const { return height_; }

    void ClearRect(double x, double y, double width, double height);
    void FillRect(double x, double y, double width, double height);
    void DrawRect(double x, double y, double width, double height);
    void DrawRoundRect(double x, double y, double width, double height, double arcWidth,
                       double arcHeight);
    void DrawLine(double x1, double y1, double x2, double y2);
    // Text with its left end at x and its baseline on y; a wrapWidth of 0 draws one line.
    void DrawString(const std::string& text, double x, double y, double wrapWidth = 0,
                    bool condense = false);

  private:
    QPainter& painter_;
    int width_;
    int height_;
    Color ground_;
};
