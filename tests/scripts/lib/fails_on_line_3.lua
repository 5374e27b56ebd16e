-- Raises an error on line 3 so the runner's report can be checked.
local x = 1
error("deliberate failure " .. x)
