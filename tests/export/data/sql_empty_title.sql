INSERT INTO articles (title,body) VALUES ("Spring Garden Tip 2 & More","Plant ""early"" 2.
Water <often> & well. ");
INSERT INTO articles (title,body) VALUES ("Spring Garden Tip 3 & More","Plant ""early"" 3.
Water <often> & well. ");
