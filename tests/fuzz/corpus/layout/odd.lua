local deep = { kind = "hbox" }
for i = 1, 50 do deep = { kind = (i % 2 == 0) and "hbox" or "grid", margins = { -5, 1e9, 0, 3 }, deep } end
return {
    ["Controls.Fuzz.Layout"] = { kind = "grid", rowstretch = { -1, 1e300 }, { name = "label", row = -3, col = 0, rowspan = 1e9 },
        { name = "slider", row = 2, col = 2, colspan = -1 }, "checkbox", "checkbox", { kind = "rest" }, { kind = "rest" } },
    ["Controls.Default.Layout"] = deep,
    ["Controls.Slider.Layout"] = { kind = "stretch", stretch = -7, width = -1, maxwidth = 0, align = "left|nonsense|" },
}
