local t = {} for i = 1, 1e9 do t[i] = ("x"):rep(100) .. i end return t
