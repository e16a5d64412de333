(defun survey-length (legs)
  "The length of a path given as a list of (dx dy) legs."
  (loop for (dx dy) in legs
        sum (sqrt (+ (* dx dx) (* dy dy)))))
