// Lit from above, from the eye, and a little from the floor.
const float c_Ambience = 0.2;
const float c_Bounce = 0.2;
const float c_Top = 0.8;
const float c_Camera = 0.5;

uniform mat4 u_View;
uniform vec3 u_Up;

varying vec4 v_Colour;
varying vec3 v_Normal;

float Diffuse(vec3 i_Normal, vec3 i_ToLight)
{
	return max(dot(i_Normal, i_ToLight), 0.0);
}

void main()
{
	vec3 normal = normalize(v_Normal);
	vec3 toCamera = vec3(u_View[0][2], u_View[1][2], u_View[2][2]);
	float light = Diffuse(normal, toCamera) * c_Camera + Diffuse(normal, -u_Up) * c_Bounce
		+ Diffuse(normal, u_Up) * c_Top + c_Ambience;
	gl_FragColor = vec4(v_Colour.rgb * light, v_Colour.a);
}
