local c = { tools = {} } c.tools[1] = c return c
