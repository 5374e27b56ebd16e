-- Small assertions for end-to-end scripts: each failure names what differed.
local check = {}

function check.eq(actual, expected, what)
  if actual ~= expected then
    error(string.format("%s: expected %s, got %s", what, tostring(expected), tostring(actual)), 2)
  end
end

function check.near(actual, expected, what, tol)
  tol = tol or 1e-9
  if type(actual) ~= "number" or math.abs(actual - expected) > tol then
    error(string.format("%s: expected %s, got %s", what, tostring(expected), tostring(actual)), 2)
  end
end

function check.fails(fn, pattern, what)
  local ok, err = pcall(fn)
  if ok then error(what .. ": expected an error", 2) end
  if pattern and not tostring(err):find(pattern) then
    error(string.format("%s: error %q does not match %q", what, tostring(err), pattern), 2)
  end
end

return check
