-- Layout descriptions of the inspector controls.
--
-- Each item is a table whose entry [1] is the description a control uses.
-- A description is a tree of nodes; sizes are in logical pixels.
--
--   "name"                              the child the control registered as "name"
--   { name = "label", <sizes> }         the same, with size rules
--   { kind = "hbox", <box>, node, ... } children side by side
--   { kind = "vbox", <box>, node, ... } children one under the other
--                                       (a table with children and no kind is a vbox)
--   { kind = "grid", <grid>, node, ... } children in cells: row = r, col = c
--                                       (from 1), rowspan, colspan
--   { kind = "space", width = w, height = h }  a fixed gap
--   { kind = "stretch" }                a gap that takes spare room
--   { kind = "rest" }                   every registered child no other node names
--
--   <sizes>  width, height (fixed); minwidth, minheight, maxwidth, maxheight;
--            stretch = share of spare room in the parent box (default 0);
--            align = "left" | "right" | "hcenter" | "top" | "bottom" | "vcenter"
--                    | "center", joined with "|": keep the preferred size and
--                    sit in the cell this way instead of filling it
--   <box>    name, spacing (default 4), margins = n or { left, top, right, bottom }
--   <grid>   name, hspacing, vspacing, margins, colstretch = { n, ... },
--            rowstretch = { n, ... }
--
-- Containers may be empty: a control fills the one named "expression" with
-- its expression field when the user adds an expression. Empty objects and
-- hidden widgets take no room. A name the control did not register is left
-- out of its layout.

-- The column that labels share, so that controls line up in an inspector.
local LABEL = { minwidth = 40, maxwidth = 110 }

local function label(extra)
    local node = { name = "label", minwidth = LABEL.minwidth, maxwidth = LABEL.maxwidth }
    for k, v in pairs(extra or {}) do node[k] = v end
    return node
end

local function expression()
    return { kind = "vbox", name = "expression", spacing = 2 }
end

return {
    -- Used for any control whose own description is missing: its children
    -- in a row, an expression field under them.
    ["Controls.Default.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4, { kind = "rest" } },
            expression(),
        },
    },

    -- The second label at the left, the box with its (maybe wrapping) text.
    ["Controls.CheckBox.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4,
                { name = "label", maxwidth = LABEL.maxwidth },
                { name = "checkbox", stretch = 1 },
            },
            expression(),
        },
    },

    -- An optional second label, then the button across the rest.
    ["Controls.Button.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4,
                label(),
                { name = "button", stretch = 1, minwidth = 40 },
            },
            expression(),
        },
    },

    ["Controls.Combo.Layout.Horizontal"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 6,
                label({ stretch = 1 }),
                { name = "combo", stretch = 2, minwidth = 60 },
            },
            expression(),
        },
    },

    ["Controls.Combo.Layout.Vertical"] = {
        { kind = "vbox", spacing = 2,
            { name = "label" },
            { name = "combo", minwidth = 60 },
            expression(),
        },
    },

    -- Label and value on one line, the slider under them across the whole
    -- width, the captions under the slider at its two ends and its middle.
    ["Controls.Slider.Layout"] = {
        { kind = "vbox", spacing = 1,
            { kind = "hbox", spacing = 6,
                { name = "label", stretch = 1 },
                -- Room for a time code, "00:00:01:12".
                { name = "edit", width = 84 },
            },
            -- The knob (14) over the reset marker (5), with a row to spare.
            { name = "slider", height = 20 },
            { kind = "grid", hspacing = 4, vspacing = 0, colstretch = { 1, 1, 1 },
                { name = "minlabel", row = 1, col = 1, align = "left|vcenter" },
                { name = "midlabel", row = 1, col = 2, align = "hcenter|vcenter" },
                { name = "maxlabel", row = 1, col = 3, align = "right|vcenter" },
            },
            expression(),
        },
    },

    -- The name over a tree of keys and values; the control sets the tree's
    -- height from its row count.
    ["Controls.ScriptValList.Layout"] = {
        { kind = "vbox", spacing = 2,
            { name = "label" },
            { name = "list", minheight = 40 },
            expression(),
        },
    },
    -- The path across the row, the browse button at its end.
    ["Controls.File.Layout"] = {
        { kind = "hbox", spacing = 4,
            label(),
            { name = "edit", stretch = 1, minwidth = 60 },
            { name = "browse", width = 24 },
        },
    },

    -- The path row, then what was found on disk and the trim boxes.
    ["Controls.Clip.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4,
                label(),
                { name = "edit", stretch = 1, minwidth = 60 },
                { name = "browse", width = 24 },
            },
            { kind = "hbox", spacing = 4,
                { name = "frames", stretch = 1 },
                { name = "in", width = 70 },
                { name = "out", width = 70 },
            },
        },
    },

    -- Family and style side by side, the preview line under them.
    ["Controls.Fontfile.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4,
                label(),
                { name = "family", stretch = 3, minwidth = 60 },
                { name = "style", stretch = 2, minwidth = 40 },
            },
            { name = "preview", minheight = 18 },
        },
    },

    -- Label and the two ends on one line, the track across the width.
    ["Controls.Range.Layout"] = {
        { kind = "vbox", spacing = 1,
            { kind = "hbox", spacing = 4,
                { name = "label", stretch = 1 },
                { name = "low", width = 64 },
                { name = "high", width = 64 },
            },
            { name = "span", height = 20 },
        },
    },

    -- The colour: the label, swatch, hex code and picker in a row; a slider
    -- per channel (alpha only where the control has one); the second view.
    ["Controls.Color.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4,
                label({ stretch = 1 }),
                { name = "swatch", width = 48, height = 18 },
                { name = "hex", width = 84 },
                { name = "pick", width = 40 },
            },
            { name = "red", height = 18 },
            { name = "green", height = 18 },
            { name = "blue", height = 18 },
            { name = "alpha", height = 18 },
            { kind = "hbox", spacing = 4,
                { name = "model", width = 44 },
                { name = "space", stretch = 1 },
            },
            expression(),
        },
    },

    -- The grading wheel: the label over the disc, the master slider and
    -- the readout under it.
    ["Controls.ColorWheel.Layout"] = {
        { kind = "vbox", spacing = 2,
            label(),
            { name = "wheel", height = 120 },
            { name = "master", height = 18 },
            { name = "readout", height = 16 },
        },
    },

    -- The gradient: the label, interpolation and the selected stop's place
    -- and colour in a row, the bar with its markers under them.
    ["Controls.Gradient.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4,
                label({ stretch = 1 }),
                { name = "interp", width = 72 },
                { name = "position", width = 52 },
                { name = "hex", width = 84 },
            },
            { name = "bar", height = 30 },
        },
    },

    -- Colour suppression: the hexagon of six hue spokes, the value boxes
    -- in two columns beside it.
    ["Controls.ColorSuppression.Layout"] = {
        { kind = "vbox", spacing = 2,
            label(),
            { kind = "hbox", spacing = 6,
                { name = "hexagon", width = 120, height = 120 },
                { kind = "grid", hspacing = 4, vspacing = 2,
                    { name = "red", row = 1, col = 1 },
                    { name = "yellow", row = 2, col = 1 },
                    { name = "green", row = 3, col = 1 },
                    { name = "cyan", row = 1, col = 2 },
                    { name = "blue", row = 2, col = 2 },
                    { name = "magenta", row = 3, col = 2 },
                },
            },
            expression(),
        },
    },

    -- The gamut: the label and the list of spaces, the xy diagram, the
    -- points as numbers.
    ["Controls.ColorGamut.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4,
                label({ stretch = 1 }),
                { name = "space", width = 110 },
            },
            { name = "diagram", height = 220 },
            { name = "readout", height = 16 },
        },
    },

    -- The pattern chooser: the label over a row of square previews.
    ["Controls.Pattern.Layout"] = {
        { kind = "vbox", spacing = 2,
            label(),
            { kind = "hbox", spacing = 4,
                { name = "pattern1", width = 40, height = 40 },
                { name = "pattern2", width = 40, height = 40 },
                { name = "pattern3", width = 40, height = 40 },
                { name = "pattern4", width = 40, height = 40 },
                { name = "pattern5", width = 40, height = 40 },
                { name = "pattern6", width = 40, height = 40 },
                { kind = "stretch" },
            },
            expression(),
        },
    },

    -- The image: the label and the image's size and channels in a row, the
    -- thumbnail under them.
    ["Controls.Image.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4,
                label({ stretch = 1 }),
                { name = "info", stretch = 1 },
            },
            { name = "thumbnail", height = 72 },
        },
    },

    -- A text or a folding header, indented by its nest level; the
    -- separator's line and the spacer's gap are hidden unless the variant
    -- shows them.
    ["Controls.Label.Layout"] = {
        { kind = "vbox", spacing = 0,
            { kind = "hbox", spacing = 0,
                "indent",
                { name = "header", stretch = 1 },
                { name = "label", stretch = 1 },
            },
            "line",
            "space",
        },
    },

    -- The buttons fill a grid that the control builds by its column count.
    ["Controls.MultiButton.Layout.Horizontal"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 6,
                label({ align = "left|top" }),
                { kind = "grid", name = "buttons", stretch = 1 },
            },
            expression(),
        },
    },

    ["Controls.MultiButton.Layout.Vertical"] = {
        { kind = "vbox", spacing = 2,
            { name = "label" },
            { kind = "grid", name = "buttons" },
            expression(),
        },
    },

    -- The name over the list; the control sets the list's height from its
    -- row count.
    ["Controls.List.Layout"] = {
        { kind = "vbox", spacing = 2,
            { name = "label" },
            { name = "list", minheight = 20 },
            expression(),
        },
    },

    -- The name and the select buttons on one line, the boxes in a grid under
    -- them that the control fills by its column count.
    ["Controls.CheckList.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4,
                { name = "label", stretch = 1 },
                { name = "all" },
                { name = "none" },
            },
            { kind = "grid", name = "items", hspacing = 8, vspacing = 2, margins = { 8, 0, 0, 0 } },
            expression(),
        },
    },

    -- The name, then X and Y sharing the rest of the line.
    ["Controls.Offset.Layout"] = {
        { kind = "hbox", spacing = 4,
            label({ stretch = 1 }),
            { name = "x", stretch = 1, minwidth = 50 },
            { name = "y", stretch = 1, minwidth = 50 },
        },
    },

    -- The name and the value on one line, the wheel across the width under them.
    ["Controls.Screw.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 6,
                { name = "label", stretch = 1 },
                { name = "edit", width = 84 },
            },
            { name = "wheel", height = 18 },
            expression(),
        },
    },

    -- The curves editor: the name and the curve buttons on one line, the
    -- graph under them (the control sets its height).
    ["Controls.Spline.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 2,
                { name = "label", stretch = 1 },
                { name = "luma", width = 22 },
                { name = "red", width = 22 },
                { name = "green", width = 22 },
                { name = "blue", width = 22 },
                { name = "alpha", width = 22 },
                { name = "linear", width = 48 },
                { name = "reset", width = 44 },
            },
            { name = "graph", minheight = 60 },
            expression(),
        },
    },

    -- Levels: the name and the channel over the histogram with its
    -- handles, the three values under it.
    ["Controls.Levels.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4,
                { name = "label", stretch = 1 },
                { name = "scale", width = 40 },
                { name = "channel", width = 70 },
            },
            { name = "histogram", height = 90 },
            { kind = "hbox", spacing = 4,
                { name = "black", stretch = 1, minwidth = 40 },
                { name = "gamma", stretch = 1, minwidth = 40 },
                { name = "white", stretch = 1, minwidth = 40 },
            },
        },
    },

    -- Output levels: the name, the ramp with its two handles, the values.
    ["Controls.LevelsOutput.Layout"] = {
        { kind = "vbox", spacing = 2,
            { name = "label" },
            { name = "ramp", height = 24 },
            { kind = "hbox", spacing = 4,
                { name = "black", stretch = 1, minwidth = 40 },
                { name = "white", stretch = 1, minwidth = 40 },
            },
        },
    },

    ["Controls.Histogram.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4,
                { name = "label", stretch = 1 },
                { name = "scale", width = 40 },
                { name = "channel", width = 70 },
            },
            { name = "histogram", height = 90 },
        },
    },

    ["Controls.ColorRanges.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4,
                { name = "label", stretch = 1 },
                { name = "reset", width = 44 },
            },
            { name = "graph", height = 110 },
        },
    },

    -- Gamma and log: the values over the transfer curve.
    ["Controls.Gamma.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4,
                { name = "label", stretch = 1 },
                { name = "edit", width = 70 },
            },
            { name = "graph", height = 100 },
            expression(),
        },
    },

    ["Controls.Log.Layout"] = {
        { kind = "vbox", spacing = 2,
            { name = "label" },
            { kind = "grid", hspacing = 4, vspacing = 2, colstretch = { 0, 1, 0, 1 },
                { name = "blackcaption", row = 1, col = 1 },
                { name = "black", row = 1, col = 2 },
                { name = "whitecaption", row = 1, col = 3 },
                { name = "white", row = 1, col = 4 },
                { name = "gammacaption", row = 2, col = 1 },
                { name = "gamma", row = 2, col = 2 },
                { name = "softclipcaption", row = 2, col = 3 },
                { name = "softclip", row = 2, col = 4 },
            },
            { name = "graph", height = 100 },
        },
    },

    -- The kernel: size and presets on one line, the grid of cells and its
    -- preview side by side, the message under them.
    ["Controls.CustomFilter.Layout"] = {
        { kind = "vbox", spacing = 2,
            { kind = "hbox", spacing = 4,
                { name = "label", stretch = 1 },
                { name = "size", width = 48 },
                { name = "blur", width = 40 },
                { name = "sharpen", width = 56 },
                { name = "edge", width = 40 },
                { name = "normalise", width = 64 },
            },
            { kind = "hbox", spacing = 6,
                { kind = "grid", name = "cells", stretch = 1 },
                { name = "preview", width = 72, height = 72 },
            },
            { name = "message" },
        },
    },
}
