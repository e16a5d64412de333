;;; A sample Lisp application that is compiled to byte code (calendar.qbc): a month on one small page.

(defparameter *calendar-months*
  #("January" "February" "March" "April" "May" "June" "July" "August" "September" "October" "November" "December"))

(defun calendar-leap-year-p (year)
  (and (zerop (mod year 4))
       (or (plusp (mod year 100)) (zerop (mod year 400)))))

(defun calendar-days (year month)
  (case month
    (2 (if (calendar-leap-year-p year) 29 28))
    ((4 6 9 11) 30)
    (t 31)))

(defun calendar-weekday (year month day)
  "0 for Monday to 6 for Sunday, in the Gregorian calendar."
  ;; January and February count as the end of the year before, so that the leap day comes last.
  (let* ((shifted-year (if (< month 3) (1- year) year))
         (offset (aref #(0 3 2 5 0 3 5 1 4 6 2 4) (1- month))))
    (mod (+ shifted-year (floor shifted-year 4) (- (floor shifted-year 100)) (floor shifted-year 400)
            offset day 6)
         7)))

(defun calendar-this-month ()
  (multiple-value-bind (second minute hour day month year) (get-decoded-time)
    (declare (ignore second minute hour day))
    (list year month)))

(defun calendar (&optional (year (first (calendar-this-month))) (month (second (calendar-this-month))))
  "Prints a month, the present one if none is given."
  (check-type year (integer 1583 *))
  (check-type month (integer 1 12))
  (let ((days (calendar-days year month))
        (title (format nil "~a ~d" (aref *calendar-months* (1- month)) year)))
    (format t "~vt~a~%" (floor (- 20 (length title)) 2) title)
    (write-line "Mo Tu We Th Fr Sa Su")
    (dotimes (blank (calendar-weekday year month 1))
      (write-string "   "))
    (loop for day from 1 to days
          do (format t "~2d" day)
             (if (or (= day days) (= 6 (calendar-weekday year month day)))
                 (terpri)
                 (write-char #\Space))))
  (princ))

(format t "~&Calendar: type (calendar) for this month, (calendar 2027 2) for another.~%")
