return { [1] = 2, Nope = 1, [true] = false }
