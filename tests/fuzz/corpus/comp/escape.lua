local ok = pcall(function() return io.open("/etc/passwd") end) return { time = ok and 1 or 0/0 }
