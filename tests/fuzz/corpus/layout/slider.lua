return {
    ["Controls.Slider.Layout"] = {
        { kind = "vbox", spacing = 1,
            { kind = "hbox", spacing = 6,
                { name = "label", stretch = 1 },
                { name = "edit", width = 84 },
            },
            { name = "slider", height = 20 },
            { kind = "grid", hspacing = 4, vspacing = 0, colstretch = { 1, 1, 1 },
                { name = "minlabel", row = 1, col = 1, align = "left|vcenter" },
                { name = "maxlabel", row = 1, col = 3, align = "right|vcenter" },
            },
            { kind = "vbox", name = "expression" },
        },
    },
}
